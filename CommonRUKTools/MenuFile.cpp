#include "CommonRUKTools/MenuFile.h"

#include "CommonRUKTools/Errors.h"

using namespace Qt::StringLiterals;

namespace {

constexpr std::size_t kDeepest = 8;
constexpr qsizetype kMostQuoted = 40;  // characters of a line, in a message

using Kind = MenuFileItem::Kind;

bool IsDigit(QChar letter) {
    return letter >= u'0' && letter <= u'9';
}

MenuFileItem CommandIn(QStringView line, int number) {
    qsizetype digits = 0;
    while (digits < line.size() && IsDigit(line[digits]))
        ++digits;
    bool fits = false;
    const int id = line.left(digits).toInt(&fits);
    const bool ends = digits == line.size() || line[digits].isSpace();
    if (digits == 0 || !ends || !fits)
        throw ERukException(MenuFileFault(
            number,
            u"\"%1\" ist weder die Nummer eines Befehls noch ein Menü."_s.arg(line.left(kMostQuoted))));
    return {.Line = number, .Id = id, .Caption = line.mid(digits).trimmed().toString()};
}

}  // namespace

QString MenuFileFault(int line, const QString& what) {
    return u"Zeile %1: "_s.arg(line) + what;
}

std::vector<MenuFileItem> ReadMenuFile(QStringView text) {
    // The menus that are open, each within the one before; the first is all of it.
    std::vector<MenuFileItem> open(1);
    int number = 0;
    for (QStringView line : text.split(u'\n')) {
        ++number;
        line = line.trimmed();
        if (line.isEmpty() || line.startsWith(u'#')) continue;
        if (line == u"}") {
            if (open.size() == 1) throw ERukException(MenuFileFault(number, u"Hier ist kein Menü offen."_s));
            MenuFileItem closed = std::move(open.back());
            open.pop_back();
            open.back().Items.push_back(std::move(closed));
        } else if (line.endsWith(u'{')) {
            const QString caption = line.chopped(1).trimmed().toString();
            if (caption.isEmpty())
                throw ERukException(MenuFileFault(number, u"Das Menü hat keinen Namen."_s));
            if (open.size() > kDeepest)
                throw ERukException(MenuFileFault(number, u"Die Menüs sind zu tief geschachtelt."_s));
            open.push_back({.What = Kind::Submenu, .Line = number, .Caption = caption});
        } else if (line == u"-") {
            open.back().Items.push_back({.What = Kind::Separator, .Line = number});
        } else {
            open.back().Items.push_back(CommandIn(line, number));
        }
    }
    if (open.size() > 1)
        throw ERukException(
            MenuFileFault(open.back().Line, u"Das Menü „%1“ hat kein Ende."_s.arg(open.back().Caption)));
    return std::move(open.front().Items);
}
