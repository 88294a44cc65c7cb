#include "MusicManagment/database/batches/LyricsTool.h"

#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QScopeGuard>
#include <QTemporaryDir>

#include "CommonRUKTools/Shell.h"
#include "tests/ErrorOf.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"

using namespace Qt::StringLiterals;

namespace {

struct RecordingShell : Shell {
    RecordingShell() { SetShell(this); }
    ~RecordingShell() override { SetShell(nullptr); }
    bool OpenWithDefaultProgram(const QString&) override { return false; }
    bool StartProgram(const QString& program, const QStringList& arguments) override {
        Program = program;
        Arguments = arguments;
        return Starts;
    }
    QString Program;
    QStringList Arguments;
    bool Starts = true;
};

QString MakeProgram(const QString& path) {
    QDir().mkpath(QFileInfo(path).path());
    QFile file(path);
    EXPECT_TRUE(file.open(QIODevice::WriteOnly) &&
                file.setPermissions(QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner));
    return path;
}

TEST(LyricsTool, TheArtistsOfTheSongsAreItsArguments) {
    const QTemporaryDir folder;
    RecordingShell shell;
    ScriptedDialogs dialogs;
    TMusicDatabase database;
    for (const QString& artist : {u"Queen"_s, u"Die Band"_s, u"Queen"_s, QString(), u"a\"b;$(x)"_s}) {
        TID3Tag song;
        song.FileName = u":00000001:\\%1.mp3"_s.arg(database.Count());
        song.Artist = artist;
        database.AddEntry(QString(), song);
    }
    const LyricsToolPlaces places{.ProgramFolder = folder.filePath(u"bin"_s),
                                  .StoredFolder = folder.filePath(u"stored"_s)};
    const auto restore = qScopeGuard([path = qgetenv("PATH")] { qputenv("PATH", path); });
    qputenv("PATH", folder.filePath(u"path"_s).toLocal8Bit());
    EXPECT_EQ(LoadLyrics(database, AllSongs(database), places), QString());
    EXPECT_EQ(dialogs.Messages,
              QStringList{u"Kann das dafür benötigte Programm LyrikfangDownloader.exe nicht finden"_s});

    // Each comes before those that were there.
    for (const QString& path :
         {u"path/LyrikfangDownloader"_s, u"stored/LyrikfangDownloader.exe"_s,
          u"bin/LyrikfangDownloader/LyrikfangDownloader"_s, u"bin/LyrikfangDownloader.exe"_s}) {
        const QString tool = MakeProgram(folder.filePath(path));
        EXPECT_EQ(LoadLyrics(database, AllSongs(database), places),
                  tool + u" \"a\"b;$(x)\" \"Die Band\" Queen"_s);
        EXPECT_EQ(shell.Program, tool);
        EXPECT_EQ(shell.Arguments, (QStringList{u"a\"b;$(x)"_s, u"Die Band"_s, u"Queen"_s}));
    }
    LoadLyrics(database, OneSong(database.Songs().HandleOf(database.Count() - 1)), places);
    EXPECT_EQ(shell.Arguments.size(), 1);
    shell.Starts = false;
    EXPECT_FALSE(ErrorOf([&] { LoadLyrics(database, AllSongs(database), places); }).isEmpty());
}

}  // namespace
