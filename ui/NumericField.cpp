#include "ui/NumericField.h"

#include <QValidator>
#include <algorithm>
#include <cmath>
#include <cstdlib>

#include "core/Convert.h"

namespace kg::ui {

namespace {

int digitCount(int n)
{
    int digits = 1;
    for (n = std::abs(n); n >= 10; n /= 10) ++digits;
    return digits;
}

// Lets in only what keeps the field a whole number within its limits (or empty). A lone minus
// sign may stand while the user goes on typing.
class WholeNumberValidator : public QValidator {
public:
    WholeNumberValidator(int minimum, int maximum, QObject* parent)
        : QValidator(parent), minimum_(minimum), maximum_(maximum),
          maxDigits_(std::max(digitCount(minimum), digitCount(maximum)))
    {
    }

    State validate(QString& input, int&) const override
    {
        if (input.isEmpty()) return Acceptable;
        const bool negative = input.startsWith('-');
        if (negative && minimum_ >= 0) return Invalid;
        const QStringView digits = QStringView(input).mid(negative ? 1 : 0);
        if (digits.isEmpty()) return Intermediate;
        if (digits.size() > maxDigits_) return Invalid;
        for (QChar c : digits)
            if (c < '0' || c > '9') return Invalid;
        const int value = input.toInt();
        return value >= minimum_ && value <= maximum_ ? Acceptable : Invalid;
    }

    void fixup(QString& input) const override
    {
        if (input == "-") input.clear();
    }

private:
    int minimum_;
    int maximum_;
    int maxDigits_;
};

}  // namespace

NumericField::NumericField(int minimum, int maximum, QWidget* parent)
    : QLineEdit(parent), minimum_(minimum), maximum_(maximum)
{
    setValidator(new WholeNumberValidator(minimum, maximum, this));
    setAlignment(Qt::AlignRight | Qt::AlignVCenter);
}

Variant NumericField::Value() const
{
    bool ok = false;
    const int value = text().toInt(&ok);
    if (!ok) return Variant::null();
    return Variant(double(value));
}

void NumericField::setValue(const Variant& value)
{
    if (value.isNull() || value.isEmpty()) {
        clear();
        return;
    }
    const double number = toDouble(value);
    if (std::isnan(number)) {
        clear();
        return;
    }
    // std::round: halves away from zero, as the field's format shows them.
    const double whole = std::round(std::clamp(number, double(minimum_), double(maximum_)));
    setText(QString::number(int(whole)));
}

}  // namespace kg::ui
