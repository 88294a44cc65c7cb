#include "MusicManagment/database/sidefile/SideFile.h"

#include <algorithm>
#include <utility>

#include "CommonRUKTools/Errors.h"
#include "CommonRUKTools/FileSource.h"
#include "CommonRUKTools/SafeFile.h"

using namespace Qt::StringLiterals;

namespace {

constexpr QStringView kHead = u"Tunestead-Side 1";
constexpr qsizetype kFields = 3;

struct Escape {
    QChar Plain;
    QChar Letter;
};
constexpr Escape kEscapes[] = {{u'\\', u'\\'}, {u'\t', u't'}, {u'\n', u'n'}, {u'\r', u'r'}};

QString Escaped(const QString& text) {
    QString escaped;
    for (const QChar c : text) {
        const auto found = std::ranges::find(kEscapes, c, &Escape::Plain);
        if (found != std::end(kEscapes))
            escaped += QStringLiteral("\\") + found->Letter;
        else
            escaped += c;
    }
    return escaped;
}

QString Unescaped(const QString& text) {
    QString plain;
    for (qsizetype i = 0; i < text.size(); ++i) {
        const bool isEscape = text[i] == u'\\' && i + 1 < text.size();
        const auto found =
            isEscape ? std::ranges::find(kEscapes, text[i + 1], &Escape::Letter) : std::end(kEscapes);
        plain += found != std::end(kEscapes) ? found->Plain : text[i];
        if (found != std::end(kEscapes)) ++i;
    }
    return plain;
}

QString ReadText(const QString& path) {
    FileSource file(path);
    const auto bytes = file.ReadExactly(0, static_cast<std::size_t>(file.Size()));
    return QString::fromUtf8(reinterpret_cast<const char*>(bytes.data()),
                             static_cast<qsizetype>(bytes.size()));
}

}  // namespace

void SideFile::Open(const QString& path) {
    Forget();
    path_ = path;
    if (!FileSource::Exists(path)) return;
    unreadable_ = path;
    const QStringList lines = ReadText(path).split(u'\n', Qt::SkipEmptyParts);
    if (!lines.isEmpty() && lines.front() != kHead)
        throw EStreamError(u"Keine Begleitdatei einer Datenbank: "_s + path);
    unreadable_.clear();
    for (const QString& line : lines.mid(1))
        TakeLine(line);
    modified_ = false;
}

void SideFile::Forget() {
    *this = SideFile();
}

void SideFile::TakeLine(const QString& line) {
    const QStringList fields = line.split(u'\t');
    if (fields.size() == kFields)
        Add(Unescaped(fields[0]), {Unescaped(fields[1]), Unescaped(fields[2])});
    else
        strange_ << line;
}

void SideFile::Save() {
    if (!modified_ || path_.isEmpty()) return;
    Write(path_);
    modified_ = false;
}

void SideFile::SaveAs(const QString& path) {
    if (path == path_ ? modified_ : HasToReplace(path)) Write(path);
    path_ = path;
    modified_ = false;
}

void SideFile::SaveCopy(const QString& path) const {
    if (HasToReplace(path)) Write(path);
}

// Nothing is written that would say nothing, unless something else is said there.
bool SideFile::HasToReplace(const QString& path) const {
    return !sections_.empty() || !strange_.isEmpty() || FileSource::Exists(path);
}

void SideFile::Write(const QString& path) const {
    if (path == unreadable_)
        throw EStreamError(u"Die Begleitdatei konnte nicht gelesen werden und wird nicht überschrieben: "_s +
                           path);
    const QByteArray text = Text().toUtf8();
    SafeFile file(path);
    file.Write(AsBytes({text.constData(), static_cast<std::size_t>(text.size())}));
    file.Commit();
}

// In one order, so that equal contents are equal files.
QString SideFile::Text() const {
    QStringList lines = strange_;
    for (const auto& [name, section] : sections_)
        for (auto row = section.cbegin(); row != section.cend(); ++row)
            lines << Escaped(name) + u'\t' + Escaped(row.key()) + u'\t' + Escaped(row.value());
    lines.sort();
    lines.prepend(kHead.toString());
    return lines.join(u'\n') + u'\n';
}

QStringList SideFile::Values(const QString& section, const QString& song) const {
    const auto found = sections_.find(section);
    return found != sections_.end() ? found->second.values(song) : QStringList();
}

bool SideFile::Contains(const QString& section, const SideRow& row) const {
    const auto found = sections_.find(section);
    return found != sections_.end() && found->second.contains(row.Song, row.Value);
}

std::vector<SideRow> SideFile::Rows(const QString& section) const {
    std::vector<SideRow> rows;
    const auto found = sections_.find(section);
    if (found == sections_.end()) return rows;
    for (auto row = found->second.cbegin(); row != found->second.cend(); ++row)
        rows.push_back({row.key(), row.value()});
    return rows;
}

void SideFile::Add(const QString& section, const SideRow& row) {
    Section& rows = sections_[section];
    if (rows.contains(row.Song, row.Value)) return;
    rows.insert(row.Song, row.Value);
    modified_ = true;
}

void SideFile::Remove(const QString& section, const SideRow& row) {
    const auto found = sections_.find(section);
    if (found == sections_.end() || found->second.remove(row.Song, row.Value) == 0) return;
    if (found->second.isEmpty()) sections_.erase(found);
    modified_ = true;
}

void SideFile::Follow(const QHash<QString, QString>& changes) {
    for (auto& [name, section] : sections_) {
        Section followed;
        for (auto row = section.cbegin(); row != section.cend(); ++row) {
            const QString song = changes.value(row.key(), row.key());
            const QString value = changes.value(row.value(), row.value());
            modified_ = modified_ || song != row.key() || value != row.value();
            followed.insert(song, value);
        }
        section = std::move(followed);
    }
}
