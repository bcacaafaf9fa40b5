#include "requests/cTavixGraph.h"

#include <cstdio>

#include "requests/Requests.h"
#include "requests/modMain.h"
#include "core/Convert.h"
#include "core/Error.h"

namespace kg {

bool Guid::operator==(const Guid& o) const
{
    if (data1 != o.data1 || data2 != o.data2 || data3 != o.data3) return false;
    for (int i = 0; i < 8; ++i)
        if (data4[i] != o.data4[i]) return false;
    return true;
}

std::string guidText(const Guid& g)
{
    char buf[40];
    std::snprintf(buf, sizeof buf, "{%08X-%04X-%04X-%02X%02X-%02X%02X%02X%02X%02X%02X}", unsigned(g.data1),
                  unsigned(g.data2), unsigned(g.data3), g.data4[0], g.data4[1], g.data4[2], g.data4[3], g.data4[4],
                  g.data4[5], g.data4[6], g.data4[7]);
    return buf;
}

DispId cTavixGraph::idOfName(std::string_view name) const
{
    for (const Operation& op : kOperations)
        if (equalsNoCase(op.name, name)) return op.id;
    throw Error::memberNotFound(objectName() + "." + std::string(name));
}

void cTavixGraph::SourceForm(const Variant& fForm)
{
    if (!fForm.isObject()) throw Error::typeMismatch("SourceForm expects an object, not a " +
                                                     std::string(typeName(fForm.type())));
    modMain::gvSourceForm = fForm;
}

void cTavixGraph::GraphInitialize() { modMain::GraphInitialize(); }

Variant cTavixGraph::invoke(DispId id, uint16_t kind, Args& args)
{
    for (const Operation& op : kOperations) {
        if (op.id != id) continue;
        try {
            return dispatch(op, kind, args);
        } catch (...) {
            // A failed request still hands the screen back: the busy pointer would otherwise stay.
            modMain::HourglassOff();
            throw;
        }
    }
    throw Error::memberNotFound(objectName() + " dispatch id " + std::to_string(id));
}

namespace {
requests::GridRequest gridRequestOf(DispId id)
{
    using R = requests::GridRequest;
    switch (id) {
    case 0x60030009: return R::YearlyRpt1;
    case 0x6003000A: return R::YearlyRpt2;
    case 0x6003000B: return R::YearlyRpt3;
    case 0x60030011: return R::PropGraph1;
    case 0x60030012: return R::PropGraph2;
    case 0x60030013: return R::PropGraph3;
    case 0x60030014: return R::HourlyGraph1;
    case 0x60030015: return R::HourlyGraph2;
    default: return R::HourlyGraph3;
    }
}
}  // namespace

Variant cTavixGraph::dispatch(const Operation& op, uint16_t kind, Args& args)
{
    if (op.kind == OperationKind::PropertyPut) {
        if (!(kind & (kPropertyPut | kPropertyPutRef)))
            throw Error::memberNotFound(std::string(op.name) + " is write-only");
        expectArgs(args, 1, op.name);
        SourceForm(args[0]);
        return {};
    }
    if (!(kind & kMethod)) throw Error::memberNotFound(std::string(op.name) + " is a method");
    switch (op.id) {
    case 0x6003000C: expectArgs(args, 0, op.name); requests::GenerateChart_BookingsReport(); return {};
    case 0x6003000D: expectArgs(args, 0, op.name); requests::GenerateChart_SalesDeclaration(); return {};
    case 0x6003000E: expectArgs(args, 0, op.name); requests::GenerateChart_JobStatusReport(); return {};
    case 0x6003000F: expectArgs(args, 0, op.name); GraphInitialize(); return {};
    case 0x60030010: expectArgs(args, 0, op.name); requests::GenerateChart_ServCatSumm(); return {};
    default: break;
    }
    expectArgs(args, 2, op.name);
    // lNumSeries is a 32-bit whole number: a value of another type is coerced as the caller's
    // automation layer would, failing with Type mismatch or Overflow.
    const int32_t lNumSeries = toLong(args[0]);
    requests::generateGridChart(gridRequestOf(op.id), lNumSeries, args[1]);
    return {};
}

}  // namespace kg
