#pragma once
// A whole-number input field with fixed limits, standing in for the numeric input control of the
// style dialog. Its Value is a Double, or Null while the field is empty (format "####0;;Null":
// an empty field shows nothing and reads as Null).
//   - Typing: only a sign and digits that keep the number within the limits get in; "46" typed
//     into a -45..45 field stops at "4". A lone "-" reads as Null until a digit follows.
//   - The program: setValue() clamps to the limits and rounds to a whole number (halves away from
//     zero, as the "####0" format shows them), so the field holds exactly what it shows.
//
//   NumericField field(-45, 45);
//   field.setValue(99.0);        // shows "45"; Value() is 45.0
//   field.clear();               // Value() is Null
#include <QLineEdit>

#include "core/Dispatch.h"  // completes Variant's object type

namespace kg::ui {

class NumericField : public QLineEdit {
    Q_OBJECT
public:
    NumericField(int minimum, int maximum, QWidget* parent = nullptr);

    int minimum() const { return minimum_; }
    int maximum() const { return maximum_; }

    // Double, or Null when the field holds no number.
    Variant Value() const;
    // A number (or a text that is one in full) is clamped and rounded; Null and Empty clear the
    // field. Another value raises Error 13, as converting it to a number would.
    void setValue(const Variant& value);

private:
    int minimum_;
    int maximum_;
};

}  // namespace kg::ui
