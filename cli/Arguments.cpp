#include "cli/Arguments.h"

#include <algorithm>

#include "CommonRUKTools/FileSource.h"

using namespace Qt::StringLiterals;

namespace {

const OptionRow* FindOption(std::span<const OptionRow> options, QStringView name) {
    const auto found = std::ranges::find_if(
        options, [name](const OptionRow& option) { return name == QStringView(option.Name); });
    return found == options.end() ? nullptr : &*found;
}

bool TakesValue(const OptionRow& option) {
    return !QStringView(option.Value).isEmpty();
}

bool MayMissValue(const OptionRow& option) {
    return QStringView(option.Value).startsWith(u'[');
}

// Whether a word behind an option that may go without a value is its value all the same.
bool IsItsValue(const QString& word) {
    return !word.startsWith(u'-') && !FileSource::Exists(word);
}

[[noreturn]] void ThrowMissingValue(const QString& name) {
    throw EUsageError(u"Die Option "_s + name + u" braucht einen Wert."_s);
}

}  // namespace

Arguments::Arguments(const QStringList& words, std::span<const OptionRow> options,
                     const OperandRow& operands) {
    QStringList rest = words;
    while (!rest.isEmpty()) {
        const QString word = rest.takeFirst();
        if (word == u"--"_s) {
            operands_ += rest;
            break;
        }
        if (word == u"--help"_s || word == u"-h"_s)
            wantsHelp_ = true;
        else if (word.size() > 1 && word.startsWith(u'-'))
            TakeOption(word, rest, options);
        else
            operands_ << word;
    }
    if (!wantsHelp_) Check(options, operands);
}

void Arguments::TakeOption(const QString& word, QStringList& rest, std::span<const OptionRow> options) {
    const auto equals = word.indexOf(u'=');
    const QString name = word.left(equals);
    const OptionRow* option = FindOption(options, name);
    if (option == nullptr) throw EUsageError(u"Unbekannte Option: "_s + name);
    if (!TakesValue(*option)) {
        if (equals >= 0) throw EUsageError(u"Die Option "_s + name + u" hat keinen Wert."_s);
        values_[name];
        return;
    }
    if (MayMissValue(*option) && equals < 0 && (rest.isEmpty() || !IsItsValue(rest.front()))) {
        values_[name];
        return;
    }
    if (equals < 0 && rest.isEmpty()) ThrowMissingValue(name);
    const QString value = equals >= 0 ? word.mid(equals + 1) : rest.takeFirst();
    if (value.isEmpty()) ThrowMissingValue(name);
    values_[name] << value;
}

void Arguments::Check(std::span<const OptionRow> options, const OperandRow& operands) const {
    for (const auto& option : options)
        if (option.Required && !Has(option.Name))
            throw EUsageError(u"Die Option "_s + QString::fromUtf16(option.Name) + u" fehlt."_s);
    const bool takesOperands = !QStringView(operands.Name).isEmpty();
    if (takesOperands && operands.Required && operands_.isEmpty())
        throw EUsageError(QString::fromUtf16(operands.Name) + u" fehlt."_s);
    const qsizetype most = !takesOperands ? 0 : operands.Several ? operands_.size() : 1;
    if (operands_.size() > most) throw EUsageError(u"Überzähliges Argument: "_s + operands_[most]);
    if (operands_.contains(QString())) throw EUsageError(u"Ein Dateiname ist leer."_s);
}

void ThrowUnknownChoice(QStringView option, const QString& word, const QStringList& choices) {
    throw EUsageError(u"Unbekannter Wert für "_s + option.toString() + u": "_s + word +
                      u". Möglich sind: "_s + choices.join(u", "_s));
}
