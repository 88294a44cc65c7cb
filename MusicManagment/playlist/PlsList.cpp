#include "CommonRUKTools/CodePage.h"
#include "MusicManagment/playlist/ListBuilder.h"
#include "MusicManagment/playlist/ListNames.h"
#include "MusicManagment/playlist/PlayListFiles.h"
#include "MusicManagment/playlist/PlsSection.h"

// PLS: the keys File1, Title1, Length1, File2, ... of the section "playlist".

using namespace Qt::StringLiterals;

namespace {

// --- Reading ---

bool IsQuoted(const QString& value) {
    return value.size() >= 2 && value.front() == value.back() &&
           (value.front() == u'"' || value.front() == u'\'');
}

QString Unquoted(const QString& value) {
    return IsQuoted(value) ? value.sliced(1, value.size() - 2) : value;
}

struct ItemKey {
    QLatin1StringView Name;
    QString PlsItem::*Value;
};

constexpr ItemKey kItemKeys[] = {
    {"File"_L1, &PlsItem::File}, {"Title"_L1, &PlsItem::Title}, {"Length"_L1, &PlsItem::Length}};

// "7"; "07" and "+7" are other keys.
std::optional<int> NumberFrom(QStringView digits) {
    bool isNumber = false;
    const int number = digits.toInt(&isNumber);
    if (!isNumber || QString::number(number) != digits) return std::nullopt;
    return number;
}

void TakeItemKey(PlsSection& section, const QString& key, const QString& value) {
    for (const auto& [name, field] : kItemKeys) {
        if (!key.startsWith(name, Qt::CaseInsensitive)) continue;
        const auto number = NumberFrom(QStringView(key).sliced(name.size()));
        if (!number) return;
        QString& text = section.Items[*number].*field;
        if (text.isNull()) text = value.isNull() ? u""_s : value;
        if (section.Items.size() > kMostListEntries) ThrowListTooLarge();
    }
}

void TakeKey(PlsSection& section, const QString& key, const QString& value) {
    if (key.compare("NumberOfEntries"_L1, Qt::CaseInsensitive) != 0) return TakeItemKey(section, key, value);
    if (!section.Count) section.Count = value.toInt();
}

}  // namespace

PlsSection ReadPlsSection(ByteSpan contents) {
    // In memory it takes several times of that; two million items of usual length take half of it.
    constexpr std::size_t kLargest = std::size_t{1} << 28;
    if (contents.size() > kLargest) ThrowListTooLarge();
    PlsSection section;
    bool isOurs = false;
    LineReader lines(contents);
    while (const auto line = lines.Next()) {
        const QString text = CodePage::FromSystem(*line).trimmed();
        if (text.startsWith(u'[')) {
            const qsizetype end = text.indexOf(u']');
            isOurs = end > 0 && text.first(end).compare("[playlist"_L1, Qt::CaseInsensitive) == 0;
            continue;
        }
        const qsizetype equals = text.indexOf(u'=');
        if (!isOurs || text.startsWith(u';') || equals < 0) continue;
        TakeKey(section, text.first(equals).trimmed(), Unquoted(text.sliced(equals + 1).trimmed()));
    }
    return section;
}

std::vector<PlayListEntry> ParsePlsList(ByteSpan contents, const QString& folder) {
    const PlsSection section = ReadPlsSection(contents);
    ListBuilder list;
    for (const auto& [number, item] : section.Items)
        if (number >= 1 && number <= section.Count.value_or(0) && !item.File.isEmpty())
            list.Add({.Name = NameFromList(item.File, folder)});
    return list.Take();
}

// --- Writing ---

namespace {

// Blanks at its ends would be lost, and quotes taken for ours.
QByteArray Quoted(const QString& name) {
    const QByteArray path = PathForList(name, CodePage::ToSystem);
    const bool isBare = path != name.toUtf8() || (name.trimmed() == name && !IsQuoted(name));
    return isBare ? path : '"' + path + '"';
}

void WriteKey(ByteWriter& file, std::string_view key, int number, const QByteArray& value) {
    file.Raw(key);
    file.Raw(AllOf(QByteArray::number(number) + '=' + value + "\r\n"));
}

}  // namespace

void WritePlsList(ByteWriter& file, std::span<const EntryToSave> entries) {
    file.Raw("[playlist]\r\n");
    int number = 0;
    for (const auto& [entry, path] : entries) {
        if (path.isEmpty()) continue;
        ++number;
        WriteKey(file, "File", number, Quoted(path));
        if (!entry->Record) continue;
        WriteKey(file, "Title", number,
                 TitleForList(entry->Record->Artist, entry->Record->Title, CodePage::ToSystem));
        WriteKey(file, "Length", number, QByteArray::number(entry->Record->Length));
    }
    file.Raw(AllOf("NumberOfEntries=" + QByteArray::number(number) + "\r\nVersion=2\r\n"));
}
