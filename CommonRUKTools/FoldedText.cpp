#include "CommonRUKTools/FoldedText.h"

#include <algorithm>
#include <array>
#include <memory>

namespace {

using FoldTable = std::array<char16_t, 0x10000>;

// Marks characters that do not fold to exactly one: their text takes the slow way.
constexpr char16_t kNotOne = 0xFFFF;

QString FoldCharacter(QChar character) {
    QString folded;
    for (const QChar part : QString(character).normalized(QString::NormalizationForm_KD).toCaseFolded())
        if (!part.isMark()) folded += part;
    return folded;
}

const FoldTable& Table() {
    static const auto table = [] {
        auto made = std::make_unique<FoldTable>();
        for (char32_t code = 0; code < made->size(); ++code) {
            const QChar character(static_cast<char16_t>(code));
            const QString folded = character.isSurrogate() ? QString(character) : FoldCharacter(character);
            (*made)[code] = folded.size() == 1 ? folded[0].unicode() : kNotOne;
        }
        (*made)[u'ß'] = kNotOne;
        (*made)[u'ẞ'] = kNotOne;
        return made;
    }();
    return *table;
}

char16_t Fold(const FoldTable& table, QChar character) {
    return table[character.unicode()];
}

bool HasOthers(const FoldTable& table, QStringView text) {
    return std::any_of(text.begin(), text.end(), [&table](QChar c) { return Fold(table, c) == kNotOne; });
}

// Where the needle's first character stands, the rest is compared; texts and needles are short.
bool ContainsSimple(const FoldTable& table, QStringView text, QStringView needle) {
    const char16_t first = needle[0].unicode();
    const QChar* const last = text.data() + (text.size() - needle.size());
    for (const QChar* at = text.data(); at <= last; ++at) {
        if (Fold(table, *at) != first) continue;
        qsizetype i = 1;
        while (i < needle.size() && Fold(table, at[i]) == needle[i].unicode())
            ++i;
        if (i == needle.size()) return true;
    }
    return false;
}

}  // namespace

QString FoldText(QStringView text) {
    const FoldTable& table = Table();
    QString folded;
    folded.reserve(text.size());
    for (const QChar character : text) {
        const char16_t simple = Fold(table, character);
        if (simple != kNotOne)
            folded += QChar(simple);
        else if (character == u'ß' || character == u'ẞ')
            folded += QStringView(u"ss");
        else
            folded += FoldCharacter(character);
    }
    return folded;
}

bool ContainsFolded(QStringView text, QStringView needle) {
    if (needle.isEmpty()) return true;
    const FoldTable& table = Table();
    if (text.size() >= needle.size() && ContainsSimple(table, text, needle)) return true;
    return HasOthers(table, text) && FoldText(text).contains(needle);
}
