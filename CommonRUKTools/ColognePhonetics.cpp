#include "CommonRUKTools/ColognePhonetics.h"

#include <QString>
#include <string_view>

namespace {

// Upper-case letters and digits of ASCII.
QByteArray LettersOf(QStringView name) {
    QByteArray letters;
    for (const QChar c : name.toString().toUpper().normalized(QString::NormalizationForm_KD)) {
        const bool isLetter = c >= u'A' && c <= u'Z';
        const bool isDigit = c >= u'0' && c <= u'9';
        if (isLetter || isDigit) letters += static_cast<char>(c.unicode());
    }
    return letters;
}

bool IsOneOf(char letter, std::string_view set) {
    return letter != 0 && set.find(letter) != std::string_view::npos;
}

// A C is a K or an S, by its neighbours.
char CodeOfC(char before, char after) {
    if (before == 0) return IsOneOf(after, "AHKLOQRUX") ? '4' : '8';
    if (IsOneOf(before, "SZ")) return '8';
    return IsOneOf(after, "AHKOQUX") ? '4' : '8';
}

// The digits of a letter between its neighbours (0 at an end), without those of silent ones.
std::string_view CodeOf(char letter, char before, char after) {
    switch (letter) {
        case 'B':
            return "1";
        case 'P':
            return after == 'H' ? "3" : "1";
        case 'D':
        case 'T':
            return IsOneOf(after, "CSZ") ? "8" : "2";
        case 'F':
        case 'V':
        case 'W':
            return "3";
        case 'G':
        case 'K':
        case 'Q':
            return "4";
        case 'C':
            return CodeOfC(before, after) == '4' ? "4" : "8";
        case 'X':
            return IsOneOf(before, "CKQ") ? "8" : "48";
        case 'L':
            return "5";
        case 'M':
        case 'N':
            return "6";
        case 'R':
            return "7";
        case 'S':
        case 'Z':
            return "8";
        case 'H':
            return "";
        default:
            return "0";  // vowels
    }
}

}  // namespace

QByteArray ColognePhonetics(QStringView name) {
    const QByteArray letters = LettersOf(name);
    QByteArray all;
    for (qsizetype i = 0; i < letters.size(); ++i) {
        const char letter = letters[i];
        const char before = i > 0 ? letters[i - 1] : '\0';
        const char after = i + 1 < letters.size() ? letters[i + 1] : '\0';
        // A digit sounds like no letter: it stands for itself, apart from the codes.
        if (letter <= '9')
            all += static_cast<char>(letter - '0' + 'a');
        else
            all += CodeOf(letter, before, after);
    }
    QByteArray code;
    for (qsizetype i = 0; i < all.size(); ++i) {
        const bool isRepeated = i > 0 && all[i] == all[i - 1];
        const bool isInnerVowel = all[i] == '0' && !code.isEmpty();
        if (!isRepeated && !isInnerVowel) code += all[i];
    }
    return code;
}
