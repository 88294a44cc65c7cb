#pragma once

#include <QSpinBox>
#include <optional>

// A length of time: the value is in milliseconds, the text in seconds or minutes with as many decimals as it
// takes, so that a value which nobody touches stays exactly what it was.
class DurationBox : public QSpinBox {
 public:
    enum class Unit { Seconds, Minutes };
    explicit DurationBox(Unit unit);

 protected:
    QString textFromValue(int value) const override;
    int valueFromText(const QString& text) const override;
    QValidator::State validate(QString& text, int& position) const override;

 private:
    // In milliseconds; nothing when the text is no number.
    std::optional<double> Parse(const QString& text) const;

    int unit_;  // milliseconds
};
