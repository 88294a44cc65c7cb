#include "CommonRUKTools/FoldedText.h"

#include <QVarLengthArray>
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

// Texts of songs fit in without asking for memory.
using Folded = QVarLengthArray<QChar, 512>;

Folded FoldAll(const FoldTable& table, QStringView text) {
    Folded folded;
    for (const QChar character : text) {
        const char16_t simple = Fold(table, character);
        if (simple != kNotOne) {
            folded.append(QChar(simple));
        } else if (character == u'ß' || character == u'ẞ') {
            folded.append(u's');
            folded.append(u's');
        } else {
            for (const QChar part : FoldCharacter(character))
                folded.append(part);
        }
    }
    return folded;
}

bool HasOthers(const FoldTable& table, QStringView text) {
    return std::any_of(text.begin(), text.end(), [&table](QChar c) { return Fold(table, c) == kNotOne; });
}

constexpr qsizetype kBlock = 16;

bool IsAscii(QStringView text) {
    char16_t all = 0;
    for (const QChar character : text)
        all |= character.unicode();
    return all < 0x80;
}

// Whether one of the `kBlock` characters from `at` may begin the needle. Says so too often, never too seldom,
// and has no branches, so that compilers look at all of them at once. `next` is where the needle's second
// character would stand for the first of them.
bool MayBegin(const char16_t* at, const char16_t* next, char16_t first, char16_t second) {
    constexpr unsigned kCaseBit = 0x20;
    const auto matches = [](unsigned text, unsigned wanted) {
        return static_cast<unsigned>((text | kCaseBit) == (wanted | kCaseBit)) |
               static_cast<unsigned>(text >= 0x80);
    };
    unsigned found = 0;
    for (qsizetype i = 0; i < kBlock; ++i)
        found |= matches(at[i], first) & matches(next[i], second);
    return found != 0;
}

bool StandsAt(const FoldTable& table, const QChar* at, QStringView needle) {
    for (qsizetype i = 0; i < needle.size(); ++i)
        if (Fold(table, at[i]) != needle[i].unicode()) return false;
    return true;
}

// Texts and needles are short; where the needle cannot begin, whole blocks are passed over.
bool ContainsSimple(const FoldTable& table, QStringView text, QStringView needle) {
    const char16_t first = needle[0].unicode();
    const qsizetype step = needle.size() > 1 ? 1 : 0;  // a needle of one letter is its own second
    const char16_t second = needle[step].unicode();
    const qsizetype places = text.size() - needle.size() + 1;
    for (qsizetype i = 0; i < places;) {
        const bool whole = i + kBlock < text.size();
        const qsizetype end = std::min(i + kBlock, places);
        if (whole && !MayBegin(text.utf16() + i, text.utf16() + i + step, first, second)) {
            i = end;
            continue;
        }
        for (; i < end; ++i)
            if (Fold(table, text[i]) == first && StandsAt(table, text.data() + i, needle)) return true;
    }
    return false;
}

}  // namespace

QString FoldText(QStringView text) {
    const Folded folded = FoldAll(Table(), text);
    return QString(folded.data(), folded.size());
}

bool ContainsFolded(QStringView text, QStringView needle) {
    if (needle.isEmpty()) return true;
    const FoldTable& table = Table();
    if (text.size() >= needle.size() && ContainsSimple(table, text, needle)) return true;
    if (IsAscii(text) || !HasOthers(table, text)) return false;
    const Folded folded = FoldAll(table, text);
    return std::search(folded.begin(), folded.end(), needle.begin(), needle.end()) != folded.end();
}
