#include "ReadMPEGHeader/id3v2/GenreText.h"

#include "ReadMPEGHeader/DerivedGenre.h"
#include "ReadMPEGHeader/Genres.h"

using namespace Qt::StringLiterals;

namespace {

std::optional<quint8> ToGenreNumber(QStringView text) {
    bool isNumber = false;
    const int number = text.trimmed().toInt(&isNumber);
    if (!isNumber || number < 0 || number > 255) return std::nullopt;
    return static_cast<quint8>(number);
}

bool IsInTable(quint8 number) {
    for (const GenreRow& row : GenreTable())
        if (row.Number == number) return true;
    return false;
}

// Collects what the references and the name in one value say.
class GenreSearch {
 public:
    void Take(QStringView value) {
        if (value.contains(u"(RX)")) remix_ = true;
        value = value.trimmed();
        while (value.startsWith(u'(') && !value.startsWith(u"((")) {
            const qsizetype end = value.indexOf(u')');
            if (end < 0) break;
            TakeReference(value.mid(1, end - 1));
            value = value.mid(end + 1).trimmed();
        }
        TakeReference(value);
        if (!known_) known_ = GenreByName(value);
        if (named_ == 0) named_ = MainGenreNamed(value);
        if (meant_ == 0) meant_ = MainGenreOfText(value);
    }

    GenreText Result() const { return {known_ ? known_ : unknown_, remix_, MainGenre()}; }

 private:
    void TakeReference(QStringView reference) {
        if (reference == u"RX") remix_ = true;
        const auto number = ToGenreNumber(reference);
        if (!number) return;
        auto& place = IsInTable(*number) ? known_ : unknown_;
        if (!place) place = number;
    }

    quint8 MainGenre() const {
        if (named_ != 0) return named_;
        const quint8 numbered = known_ ? MainGenreOfGenre(*known_) : quint8{0};
        return numbered != 0 ? numbered : meant_;
    }

    std::optional<quint8> known_;
    std::optional<quint8> unknown_;  // a number without a name is better than none
    bool remix_ = false;
    quint8 named_ = 0;  // main genre whose name the text is
    quint8 meant_ = 0;  // main genre to which the text belongs
};

GenreText ParseClassic(const QString& text) {
    GenreText result;
    result.Remix = text.contains(u"(RX)");
    if (text.size() < 2 || !text.startsWith(u'(')) return result;
    const QStringView rest = QStringView(text).mid(1);
    result.Genre = ToGenreNumber(rest.left(rest.indexOf(u')')));
    return result;
}

}  // namespace

GenreText ParseGenre(TextRules rules, const QStringList& values) {
    if (rules == TextRules::Classic) return ParseClassic(values.value(0));
    GenreSearch search;
    for (const QString& value : values)
        search.Take(value);
    return search.Result();
}
