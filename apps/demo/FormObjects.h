#pragma once
// The report screen as the component reaches it: the source form and its members as host objects
// over the Qt widgets, read at the moment the component asks.
//   form:   grid1, grid2, grid3, gridsettings1 (grids), dtpFromDate, dtpToDate (pickers),
//           cboFields(1) (the field list; the control array has only element 1)
//   grid:   Rows, FixedRows, cols, textmatrix(r, c), GetValueFromCell(r, c)
//   picker: Value (a date)
//   list:   ListCount, List(i)
// A grid's caption rows are the table's first rows (its "FixedRows" property, 1 when unset); its
// first column holds the row captions. A widget that is gone answers with Error 364.
#include <QString>

#include "apps/demo/ComponentLibrary.h"

class QDate;
class QWidget;

namespace kg::demo {

// A new source form over the widgets named as above among `screen`'s children; one reference for
// the caller.
KGObject* makeSourceForm(const ComponentApi& api, QWidget* screen);

// The date's serial as a KG_VT_DATE holds it: days since 30 Dec 1899.
double dateSerial(const QDate& date);

// A cell's value as GetValueFromCell gives it: a number when the text reads as one, Null when the
// text is empty (blanks only), else the text.
void cellValue(const ComponentApi& api, const QString& text, KGVariant* out);

}  // namespace kg::demo
