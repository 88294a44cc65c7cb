#pragma once

#include <QHash>
#include <QMultiHash>
#include <QString>
#include <QStringList>
#include <map>
#include <vector>

// A row of a section: a song, by its stored path, and what is said of it.
struct SideRow {
    QString Song;
    QString Value;

    bool operator==(const SideRow&) const = default;
};

// What the collection knows of songs and the record has no field for, in a file of its own beside the
// database (docs/formats.md). Each capability has a section of its own, whose rows it alone understands;
// sections that nobody asks for stay in the file. Without the file the collection works.
class SideFile {
 public:
    // The file beside a database.
    static QString PathFor(const QString& database) { return database + QStringLiteral(".side"); }

    // Forgets everything and reads the file; one that is not there is empty. Throws EStreamError for one that
    // cannot be read or is none; it is then not saved over.
    void Open(const QString& path);
    void Forget();
    // Writes what has changed. Rows without a file wait for one. Throws EStreamError; the file is then as it
    // was.
    void Save();
    // From now on the rows are kept in this file.
    void SaveAs(const QString& path);
    void SaveCopy(const QString& path) const;

    QStringList Values(const QString& section, const QString& song) const;
    bool Contains(const QString& section, const SideRow& row) const;
    std::vector<SideRow> Rows(const QString& section) const;
    // A row that is there already is not added again.
    void Add(const QString& section, const SideRow& row);
    void Remove(const QString& section, const SideRow& row);
    // Songs have other paths now: old path to new. Values that are paths follow, too.
    void Follow(const QHash<QString, QString>& changes);

 private:
    using Section = QMultiHash<QString, QString>;

    void TakeLine(const QString& line);
    QString Text() const;
    bool HasToReplace(const QString& path) const;
    void Write(const QString& path) const;

    std::map<QString, Section> sections_;
    QStringList strange_;  // lines that nobody understands
    QString path_;         // empty: not kept in a file
    QString unreadable_;
    bool modified_ = false;
};
