#include <map>

#include "CommonRUKTools/CodePage.h"
#include "MusicManagment/playlist/ListNames.h"
#include "MusicManagment/playlist/PlayListFiles.h"

// PLS, a list in the form of an INI file: the keys File1, File2, ... of the section "playlist". Names are
// taken by their bytes, commas and backslashes too, which a general reader of INI files would interpret.

using namespace Qt::StringLiterals;

namespace {

// The keys of the section that this format needs.
struct PlsSection {
    std::map<int, QString> Files;  // by number; of a number that comes twice the first counts
    std::optional<int> Count{};
};

QString Unquoted(const QString& value) {
    const bool isQuoted = value.size() >= 2 && value.front() == value.back() &&
                          (value.front() == u'"' || value.front() == u'\'');
    return isQuoted ? value.sliced(1, value.size() - 2) : value;
}

void TakeKey(PlsSection& section, const QString& key, const QString& value) {
    bool isNumber = false;
    if (key.compare("NumberOfEntries"_L1, Qt::CaseInsensitive) == 0) {
        const int count = value.toInt(&isNumber);
        if (!section.Count) section.Count = isNumber ? count : 0;
    } else if (key.startsWith("File"_L1, Qt::CaseInsensitive)) {
        const int number = QStringView(key).sliced(4).toInt(&isNumber);
        if (isNumber && section.Files.size() <= kMostListEntries) section.Files.emplace(number, value);
    }
}

PlsSection ReadSection(ByteSpan contents) {
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

void WriteKey(ByteWriter& file, std::string_view key, int number, const QByteArray& value) {
    file.Raw(key);
    file.Raw(AllOf(QByteArray::number(number) + '=' + value + "\r\n"));
}

}  // namespace

std::vector<PlayListEntry> ParsePlsList(ByteSpan contents) {
    const PlsSection section = ReadSection(contents);
    std::vector<PlayListEntry> entries;
    for (const auto& [number, value] : section.Files) {
        if (number < 1 || number > section.Count.value_or(0) || value.isEmpty()) continue;
        AppendEntry(entries, {.Name = NameFromList(value)});
    }
    return entries;
}

void WritePlsList(ByteWriter& file, std::span<const EntryToSave> entries) {
    file.Raw("[playlist]\r\n");
    int number = 0;
    for (const auto& [entry, path] : entries) {
        if (path.isEmpty()) continue;
        ++number;
        WriteKey(file, "File", number, PathForList(path));
        if (!entry->Record) continue;
        WriteKey(file, "Title", number, TitleForList(entry->Record->Artist, entry->Record->Title));
        WriteKey(file, "Length", number, QByteArray::number(entry->Record->Length));
    }
    file.Raw(AllOf("NumberOfEntries=" + QByteArray::number(number) + "\r\nVersion=2\r\n"));
}
