#include "app/dialogs/options/DurationBox.h"

#include <cmath>

using namespace Qt::StringLiterals;

DurationBox::DurationBox(Unit unit) : unit_(unit == Unit::Seconds ? 1000 : 60'000) {
    setSuffix(unit == Unit::Seconds ? u" s"_s : u" min"_s);
    setSingleStep(unit_);
}

QString DurationBox::textFromValue(int value) const {
    return locale().toString(static_cast<double>(value) / unit_, 'f', QLocale::FloatingPointShortest);
}

int DurationBox::valueFromText(const QString& text) const {
    const double value = Parse(text).value_or(minimum());
    return static_cast<int>(std::lround(std::clamp<double>(value, minimum(), maximum())));
}

QValidator::State DurationBox::validate(QString& text, int&) const {
    const auto value = Parse(text);
    if (!value) return text.contains(u'-') ? QValidator::Invalid : QValidator::Intermediate;
    if (*value > maximum()) return QValidator::Invalid;
    return *value < minimum() ? QValidator::Intermediate : QValidator::Acceptable;
}

std::optional<double> DurationBox::Parse(const QString& text) const {
    QString number = text;
    if (number.endsWith(suffix())) number.chop(suffix().size());
    bool isNumber = false;
    const double value = locale().toDouble(number.trimmed(), &isNumber);
    return isNumber && std::isfinite(value) ? std::optional(value * unit_) : std::nullopt;
}
