#pragma once

#include <QHash>
#include <QString>
#include <QStringList>
#include <span>

#include "CommonRUKTools/Errors.h"

// The command line is not one that the program understands.
class EUsageError : public ERukException {
 public:
    using ERukException::ERukException;
};

// An option of a command. A row of the help as well.
struct OptionRow {
    const char16_t* Name;   // with its dashes: "--db"
    const char16_t* Value;  // what the help calls its value; empty for a switch, "[NAME]" where it may miss
    const char16_t* Help;
    bool Required = false;
};

// What stands besides the options.
struct OperandRow {
    const char16_t* Name;  // empty: nothing may stand there
    const char16_t* Help;
    bool Several = true;   // whether more than one may stand there
    bool Required = true;  // whether at least one must
};

// The words behind the command, sorted out.
class Arguments {
 public:
    // "--name value", "--name=value" and operands in any order; behind "--" everything is an operand. A word
    // that leads to a file is no value of an option that may go without one. Throws EUsageError.
    Arguments(const QStringList& words, std::span<const OptionRow> options, const OperandRow& operands);

    bool Has(QStringView option) const { return values_.contains(option.toString()); }
    // Empty when the option is not given; the last one where it is given more than once.
    QString Value(QStringView option) const { return Values(option).value(Values(option).size() - 1); }
    // All of them, in their order.
    QStringList Values(QStringView option) const { return values_.value(option.toString()); }
    const QStringList& Operands() const { return operands_; }
    bool WantsHelp() const { return wantsHelp_; }

 private:
    void TakeOption(const QString& word, QStringList& rest, std::span<const OptionRow> options);
    void Check(std::span<const OptionRow> options, const OperandRow& operands) const;

    QHash<QString, QStringList> values_;
    QStringList operands_;
    bool wantsHelp_ = false;
};

// A word that stands for a value on the command line.
template <typename T>
struct ChoiceRow {
    const char16_t* Name;
    T Value;
};

[[noreturn]] void ThrowUnknownChoice(QStringView option, const QString& word, const QStringList& choices);

// The value of an option that allows only the words of a table; `otherwise` when the option is not given.
// Throws EUsageError.
template <typename T, std::size_t N>
T ChoiceOf(const Arguments& arguments, QStringView option, const ChoiceRow<T> (&choices)[N], T otherwise) {
    if (!arguments.Has(option)) return otherwise;
    const QString word = arguments.Value(option);
    QStringList names;
    for (const auto& choice : choices) {
        if (word == QStringView(choice.Name)) return choice.Value;
        names << QString::fromUtf16(choice.Name);
    }
    ThrowUnknownChoice(option, word, names);
}
