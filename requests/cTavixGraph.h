#pragma once
// The public automation class: `SourceForm`, `GraphInitialize` and the thirteen chart requests,
// reached through the default interface `_cTavixGraph` by dispatch id or by name. The class holds
// no data of its own; everything lives in the shared state (requests/modMain.h).
#include <array>
#include <cstdint>

#include <string_view>

#include "core/Convert.h"
#include "core/Dispatch.h"
#include "karstgraph/karstgraph.h"  // the ids as the host sees them, checked against the table
#include "requests/Requests.h"

namespace kg {

struct Guid {
    uint32_t data1;
    uint16_t data2, data3;
    uint8_t data4[8];
    bool operator==(const Guid& o) const;
};
std::string guidText(const Guid& g);  // "{XXXXXXXX-XXXX-XXXX-XXXX-XXXXXXXXXXXX}"

constexpr Guid kClsidTavixGraph = {0x6B2E5C1A, 0x4F3D, 0x4E8B, {0x9A, 0x7C, 0x2D, 0x1F, 0x0E, 0x3B, 0x5A, 0x64}};
constexpr Guid kIidTavixGraph = {0x9C4D7E2B, 0x1A5F, 0x4B6C, {0x8D, 0x3E, 0x7F, 0x0A, 0x2C, 0x9B, 0x4E, 0x15}};
constexpr const char* kProgId = "KarstGraph.cTavixGraph";
constexpr const char* kInterfaceName = "_cTavixGraph";

// The interface's operations in slot order: the one table of their ids, names, argument shapes
// and handlers. The CLI, the docs and the tests read it; the C header's KG_DISPID_* are checked
// against it below.
enum class OperationKind { PropertyPut, Method };
// What a call passes: the form object, nothing, or lNumSeries and vTotal.
enum class ArgumentShape { Form, None, SeriesAndTotal };
struct Operation;
// Runs the operation on arguments already counted against the shape.
using OperationHandler = void (*)(const Operation& op, Args& args);

struct Operation {
    int slot;
    const char* name;
    OperationKind kind;
    const char* parameters;  // as the type library shows them
    DispId id;
    ArgumentShape arguments;
    const char* grid;    // the source form's grid a grid request charts; "" for the others
    bool measureChoice;  // asks the data choice dialog
    OperationHandler handler;
};

namespace handlers {
void SourceForm(const Operation& op, Args& args);
void GraphInitialize(const Operation& op, Args& args);
void BookingsReport(const Operation& op, Args& args);
void SalesDeclaration(const Operation& op, Args& args);
void JobStatusReport(const Operation& op, Args& args);
void ServCatSumm(const Operation& op, Args& args);
template <requests::GridRequest request>
void grid(const Operation& op, Args& args)
{
    // lNumSeries is a 32-bit whole number: a value of another type is coerced as the caller's
    // automation layer would, failing with Type mismatch or Overflow.
    requests::generateGridChart(request, op.grid, toLong(args[0]), args[1]);
}
}  // namespace handlers

namespace ops {
using K = OperationKind;
using A = ArgumentShape;
using G = requests::GridRequest;
constexpr const char* kSeries = "lNumSeries As Long, vTotal As Variant";
}  // namespace ops

constexpr std::array<Operation, 15> kOperations = {{
    {1, "SourceForm", ops::K::PropertyPut, "fForm As Variant (by value)", 0x68030008, ops::A::Form, "", false,
     handlers::SourceForm},
    {2, "GenerateChart_YearlyRpt1", ops::K::Method, ops::kSeries, 0x60030009, ops::A::SeriesAndTotal, "grid1", false,
     handlers::grid<ops::G::YearlyRpt1>},
    {3, "GenerateChart_YearlyRpt2", ops::K::Method, ops::kSeries, 0x6003000A, ops::A::SeriesAndTotal, "grid2", false,
     handlers::grid<ops::G::YearlyRpt2>},
    {4, "GenerateChart_YearlyRpt3", ops::K::Method, ops::kSeries, 0x6003000B, ops::A::SeriesAndTotal, "grid3", false,
     handlers::grid<ops::G::YearlyRpt3>},
    {5, "GenerateChart_BookingsReport", ops::K::Method, "", 0x6003000C, ops::A::None, "", true,
     handlers::BookingsReport},
    {6, "GenerateChart_SalesDeclaration", ops::K::Method, "", 0x6003000D, ops::A::None, "", true,
     handlers::SalesDeclaration},
    {7, "GenerateChart_JobStatusReport", ops::K::Method, "", 0x6003000E, ops::A::None, "", false,
     handlers::JobStatusReport},
    {8, "GraphInitialize", ops::K::Method, "", 0x6003000F, ops::A::None, "", false, handlers::GraphInitialize},
    {9, "GenerateChart_ServCatSumm", ops::K::Method, "", 0x60030010, ops::A::None, "", true, handlers::ServCatSumm},
    {10, "GenerateChart_PropGraph1", ops::K::Method, ops::kSeries, 0x60030011, ops::A::SeriesAndTotal, "grid1", false,
     handlers::grid<ops::G::PropGraph1>},
    {11, "GenerateChart_PropGraph2", ops::K::Method, ops::kSeries, 0x60030012, ops::A::SeriesAndTotal, "grid2", false,
     handlers::grid<ops::G::PropGraph2>},
    {12, "GenerateChart_PropGraph3", ops::K::Method, ops::kSeries, 0x60030013, ops::A::SeriesAndTotal, "grid3", false,
     handlers::grid<ops::G::PropGraph3>},
    {13, "GenerateChart_HourlyGraph1", ops::K::Method, ops::kSeries, 0x60030014, ops::A::SeriesAndTotal, "grid1",
     false, handlers::grid<ops::G::HourlyGraph1>},
    {14, "GenerateChart_HourlyGraph2", ops::K::Method, ops::kSeries, 0x60030015, ops::A::SeriesAndTotal, "grid2",
     false, handlers::grid<ops::G::HourlyGraph2>},
    {15, "GenerateChart_HourlyGraph3", ops::K::Method, ops::kSeries, 0x60030016, ops::A::SeriesAndTotal, "grid3",
     false, handlers::grid<ops::G::HourlyGraph3>},
}};

// The row of an exact name, for compile-time checks; an unknown name does not compile.
constexpr const Operation& operationNamed(std::string_view name)
{
    for (const Operation& op : kOperations)
        if (name == op.name) return op;
    throw "no such operation";
}
// The row of a name in any case, as late binding finds it; nullptr when there is none.
const Operation* findOperation(std::string_view name);

// The C header states the same ids to the host: they must agree.
static_assert(operationNamed("SourceForm").id == KG_DISPID_SOURCEFORM);
static_assert(operationNamed("GenerateChart_YearlyRpt1").id == KG_DISPID_GENERATECHART_YEARLYRPT1);
static_assert(operationNamed("GenerateChart_YearlyRpt2").id == KG_DISPID_GENERATECHART_YEARLYRPT2);
static_assert(operationNamed("GenerateChart_YearlyRpt3").id == KG_DISPID_GENERATECHART_YEARLYRPT3);
static_assert(operationNamed("GenerateChart_BookingsReport").id == KG_DISPID_GENERATECHART_BOOKINGSREPORT);
static_assert(operationNamed("GenerateChart_SalesDeclaration").id == KG_DISPID_GENERATECHART_SALESDECLARATION);
static_assert(operationNamed("GenerateChart_JobStatusReport").id == KG_DISPID_GENERATECHART_JOBSTATUSREPORT);
static_assert(operationNamed("GraphInitialize").id == KG_DISPID_GRAPHINITIALIZE);
static_assert(operationNamed("GenerateChart_ServCatSumm").id == KG_DISPID_GENERATECHART_SERVCATSUMM);
static_assert(operationNamed("GenerateChart_PropGraph1").id == KG_DISPID_GENERATECHART_PROPGRAPH1);
static_assert(operationNamed("GenerateChart_PropGraph2").id == KG_DISPID_GENERATECHART_PROPGRAPH2);
static_assert(operationNamed("GenerateChart_PropGraph3").id == KG_DISPID_GENERATECHART_PROPGRAPH3);
static_assert(operationNamed("GenerateChart_HourlyGraph1").id == KG_DISPID_GENERATECHART_HOURLYGRAPH1);
static_assert(operationNamed("GenerateChart_HourlyGraph2").id == KG_DISPID_GENERATECHART_HOURLYGRAPH2);
static_assert(operationNamed("GenerateChart_HourlyGraph3").id == KG_DISPID_GENERATECHART_HOURLYGRAPH3);

class cTavixGraph : public Object {
public:
    DispId idOfName(std::string_view name) const override;
    Variant invoke(DispId id, uint16_t kind, Args& args) override;
    std::string objectName() const override { return "cTavixGraph"; }

    // The operations, callable from C++ as well.
    void SourceForm(const Variant& form);
    void GraphInitialize();

private:
    Variant dispatch(const Operation& op, uint16_t kind, Args& args);
};

}  // namespace kg
