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

const Operation* findOperation(std::string_view name)
{
    for (const Operation& op : kOperations)
        if (equalsNoCase(op.name, name)) return &op;
    return nullptr;
}

DispId cTavixGraph::idOfName(std::string_view name) const
{
    if (const Operation* op = findOperation(name)) return op->id;
    throw Error::memberNotFound(objectName() + "." + std::string(name));
}

void cTavixGraph::SourceForm(const Variant& form)
{
    Args args{form};
    handlers::SourceForm(operationNamed("SourceForm"), args);
}

void cTavixGraph::GraphInitialize() { modMain::GraphInitialize(); }

namespace handlers {
void SourceForm(const Operation&, Args& args)
{
    const Variant& form = args[0];
    if (!form.isObject()) throw Error::typeMismatch("SourceForm expects an object, not a " +
                                                    std::string(typeName(form.type())));
    modMain::gvSourceForm = form;
}
void GraphInitialize(const Operation&, Args&) { modMain::GraphInitialize(); }
void BookingsReport(const Operation&, Args&) { requests::GenerateChart_BookingsReport(); }
void SalesDeclaration(const Operation&, Args&) { requests::GenerateChart_SalesDeclaration(); }
void JobStatusReport(const Operation&, Args&) { requests::GenerateChart_JobStatusReport(); }
void ServCatSumm(const Operation&, Args&) { requests::GenerateChart_ServCatSumm(); }
}  // namespace handlers

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

Variant cTavixGraph::dispatch(const Operation& op, uint16_t kind, Args& args)
{
    if (op.kind == OperationKind::PropertyPut) {
        if (!(kind & (kPropertyPut | kPropertyPutRef)))
            throw Error::memberNotFound(std::string(op.name) + " is write-only");
    } else if (!(kind & kMethod)) {
        throw Error::memberNotFound(std::string(op.name) + " is a method");
    }
    switch (op.arguments) {
    case ArgumentShape::Form: expectArgs(args, 1, op.name); break;
    case ArgumentShape::None: expectArgs(args, 0, op.name); break;
    case ArgumentShape::SeriesAndTotal: expectArgs(args, 2, op.name); break;
    }
    op.handler(op, args);
    return {};
}

}  // namespace kg
