#pragma once
// The public automation class: `SourceForm`, `GraphInitialize` and the thirteen chart requests,
// reached through the default interface `_cTavixGraph` by dispatch id or by name. The class holds
// no data of its own; everything lives in the shared state (requests/modMain.h).
#include <array>
#include <cstdint>

#include "core/Dispatch.h"

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

// The interface's operations in slot order, with their dispatch ids.
enum class OperationKind { PropertyPut, Method };
struct Operation {
    int slot;
    const char* name;
    OperationKind kind;
    const char* parameters;
    DispId id;
};
constexpr std::array<Operation, 15> kOperations = {{
    {1, "SourceForm", OperationKind::PropertyPut, "fForm As Variant (by value)", 0x68030008},
    {2, "GenerateChart_YearlyRpt1", OperationKind::Method, "lNumSeries As Long, vTotal As Variant", 0x60030009},
    {3, "GenerateChart_YearlyRpt2", OperationKind::Method, "lNumSeries As Long, vTotal As Variant", 0x6003000A},
    {4, "GenerateChart_YearlyRpt3", OperationKind::Method, "lNumSeries As Long, vTotal As Variant", 0x6003000B},
    {5, "GenerateChart_BookingsReport", OperationKind::Method, "", 0x6003000C},
    {6, "GenerateChart_SalesDeclaration", OperationKind::Method, "", 0x6003000D},
    {7, "GenerateChart_JobStatusReport", OperationKind::Method, "", 0x6003000E},
    {8, "GraphInitialize", OperationKind::Method, "", 0x6003000F},
    {9, "GenerateChart_ServCatSumm", OperationKind::Method, "", 0x60030010},
    {10, "GenerateChart_PropGraph1", OperationKind::Method, "lNumSeries As Long, vTotal As Variant", 0x60030011},
    {11, "GenerateChart_PropGraph2", OperationKind::Method, "lNumSeries As Long, vTotal As Variant", 0x60030012},
    {12, "GenerateChart_PropGraph3", OperationKind::Method, "lNumSeries As Long, vTotal As Variant", 0x60030013},
    {13, "GenerateChart_HourlyGraph1", OperationKind::Method, "lNumSeries As Long, vTotal As Variant", 0x60030014},
    {14, "GenerateChart_HourlyGraph2", OperationKind::Method, "lNumSeries As Long, vTotal As Variant", 0x60030015},
    {15, "GenerateChart_HourlyGraph3", OperationKind::Method, "lNumSeries As Long, vTotal As Variant", 0x60030016},
}};

class cTavixGraph : public Object {
public:
    DispId idOfName(std::string_view name) const override;
    Variant invoke(DispId id, uint16_t kind, Args& args) override;
    std::string objectName() const override { return "cTavixGraph"; }

    // The operations, callable from C++ as well.
    void SourceForm(const Variant& fForm);
    void GraphInitialize();

private:
    Variant dispatch(const Operation& op, uint16_t kind, Args& args);
};

}  // namespace kg
