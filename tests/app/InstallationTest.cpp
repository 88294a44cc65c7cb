#include "app/desktop/Installation.h"

#include <gtest/gtest.h>

#include <QDirIterator>
#include <QRegularExpression>

#include "app/desktop/DesktopEntry.h"
#include "app/desktop/InstallationSteps.h"
#include "app/desktop/MimeTypes.h"
#include "tests/ErrorOf.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/database/RecordingTrash.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kYes = 0;
constexpr int kNo = 1;

class InstallationTest : public testing::Test {
 protected:
    InstallationTest() { Write(u"bin/tunestead"_s, "a program"); }

    QString In(const QString& name) const { return folder_.Path(name); }
    void Write(const QString& name, const QByteArray& contents) const { folder_.Put(name, contents); }
    QByteArray Read(const QString& name) const { return folder_.Get(name); }
    // Every file below the temporary folder but the program.
    QStringList Files() const {
        QStringList files;
        QDirIterator each(folder_.Path(), QDir::Files, QDirIterator::Subdirectories);
        while (each.hasNext())
            files << QDir(folder_.Path()).relativeFilePath(each.next());
        files.removeAll(u"bin/tunestead"_s);
        files.sort();
        return files;
    }
    Installation Of(const QString& program) {
        return Installation({In(program), In(u"data"_s), In(u"config"_s)},
                            [this](const QString& tool, const QStringList& arguments) {
                                runs_ << tool + u' ' + arguments.join(u' ');
                                return complaint_;
                            });
    }

    const QString entry_ = u"data/applications/tunestead.desktop"_s;
    const QStringList installed_ = {entry_, u"data/icons/hicolor/scalable/apps/tunestead.svg"_s,
                                    u"data/mime/packages/tunestead.xml"_s};
    SongFolder folder_;
    QStringList runs_;
    QString complaint_;
    Installation installation_ = Of(u"bin/tunestead"_s);
};

TEST_F(InstallationTest, RemovingLeavesWhatWasThereBefore) {
    const QByteArray defaults =
        "[Default Applications]\naudio/mpeg=tunestead.desktop;player.desktop\ntext/plain=editor.desktop\n";
    Write(u"config/mimeapps.list"_s, defaults);
    Write(u"data/mime/packages/other.xml"_s, "<other/>");
    const QStringList before = Files();

    EXPECT_EQ(installation_.Install(In(u"links"_s)), QStringList());
    EXPECT_EQ(Files().size(), before.size() + 4);
    EXPECT_TRUE(QFileInfo(In(u"links/tunestead.desktop"_s)).isExecutable());
    EXPECT_TRUE(Read(installed_[1]).contains("<svg"));
    ASSERT_EQ(runs_.size(), 3);
    EXPECT_EQ(runs_[0], u"update-mime-database "_s + In(u"data/mime"_s));
    EXPECT_EQ(runs_[1], u"update-desktop-database "_s + In(u"data/applications"_s));
    EXPECT_TRUE(runs_[2].startsWith(u"xdg-mime default tunestead.desktop application/x-tunestead-"_s));
    EXPECT_FALSE(runs_[2].contains(u"audio/"_s));

    // As xdg-mime writes it, and another program that the user has put first.
    Write(u"config/mimeapps.list"_s,
          defaults +
              "application/x-tunestead-database=tunestead.desktop\n"
              "application/x-tunestead-desktop=other.desktop;tunestead.desktop;\n");
    installation_.Remove(In(u"links"_s));
    EXPECT_EQ(Files(), before);
    EXPECT_EQ(Read(u"config/mimeapps.list"_s), defaults + "application/x-tunestead-desktop=other.desktop;\n");
    installation_.Remove(In(u"links"_s));  // nothing left to remove

    Write(u"config/mimeapps.list"_s,
          "\n[Default Applications]\napplication/x-tunestead-database=tunestead.desktop\n");
    installation_.Remove({});
    EXPECT_FALSE(Files().contains(u"config/mimeapps.list"_s));
}

TEST_F(InstallationTest, AShortcutThatTheUserMadeStays) {
    Write(u"links/tunestead.desktop"_s, "[Desktop Entry]\nExec=something\n");
    installation_.Remove(In(u"links"_s));
    EXPECT_EQ(Files(), QStringList{u"links/tunestead.desktop"_s});
}

TEST_F(InstallationTest, OnlyAnOutdatedInstallationOfThisProgramIsRenewed) {
    installation_.Refresh();
    EXPECT_EQ(Files(), QStringList());

    installation_.Install({});
    runs_.clear();
    installation_.Refresh();
    EXPECT_EQ(runs_, QStringList());

    const QByteArray current = Read(installed_[2]);
    Write(installed_[2], "<older/>");
    Write(u"copy/tunestead"_s, "another copy of the program");
    Of(u"copy/tunestead"_s).Refresh();
    EXPECT_EQ(Read(installed_[2]), "<older/>");
    installation_.Refresh();
    EXPECT_EQ(Read(installed_[2]), current);
    EXPECT_EQ(runs_.size(), 2) << "the user's choice of programs stays";

    QFile::remove(In(u"bin/tunestead"_s));  // the program has moved
    Of(u"copy/tunestead"_s).Refresh();
    EXPECT_EQ(InstalledProgram(Read(entry_)), In(u"copy/tunestead"_s));
}

TEST(DesktopEntryTest, TheProgramsPathIsQuoted) {
    const QByteArray packed = "[Desktop Entry]\nExec=tunestead %F\nIcon=tunestead\n";
    const std::pair<QString, QByteArray> cases[] = {
        {u"/opt/Meine Musik/tunestead"_s, R"(Exec="/opt/Meine Musik/tunestead" %F)"},
        {u"/opt/100%/ä/tunestead"_s, R"(Exec="/opt/100%%/ä/tunestead" %F)"},
        {uR"(/o"p`t/$x\y/tunestead)"_s, R"(Exec="/o\\"p\\`t/\\$x\\\\y/tunestead" %F)"}};
    for (const auto& [program, line] : cases) {
        const QByteArray entry = EntryFor(packed, program);
        EXPECT_TRUE(entry.split('\n').contains(line)) << entry.toStdString();
        EXPECT_TRUE(entry.endsWith("Icon=tunestead\n"));
        EXPECT_EQ(InstalledProgram(entry), program);
    }
    EXPECT_EQ(InstalledProgram(packed), QString());
}

// Which extensions a type has is said in code, for the program's start, and in the file for the desktop.
TEST(MimeTypesTest, TheDesktopIsToldWhatTheProgramKnows) {
    const auto text = [](const QString& name) {
        QFile file(u":/desktop/"_s + name);
        return file.open(QIODevice::ReadOnly) ? QString::fromUtf8(file.readAll()) : QString();
    };
    const QRegularExpression words(
        uR"re(mime-type type="([^"]*)"|<comment[^>]*>([^<]*)<|pattern="[*]([^"]*)")re"_s);
    QStringList said;
    QString type;
    for (const auto& word : words.globalMatch(text(u"tunestead-mime.xml"_s))) {
        if (word.hasCaptured(1))
            type = word.captured(1);
        else
            said << type + (word.hasCaptured(2) ? u": "_s + word.captured(2) : u" *"_s + word.captured(3));
    }
    const QString menu = text(u"tunestead.desktop"_s);
    QStringList known;
    for (const FileType& each : OwnFileTypes()) {
        const QString name = each.MimeType.toString();
        known << name + u": "_s + each.Description.toString();
        for (const QStringView extension : each.Extensions)
            if (!extension.isEmpty()) known << name + u" *"_s + extension.toString();
        EXPECT_TRUE(menu.contains(name + u';'));
    }
    said.sort();
    known.sort();
    EXPECT_EQ(said, known);
}

TEST_F(InstallationTest, TheUserSaysWhatGoesWithTheProgram) {
    const StandardFiles files{In(u"data/tunestead"_s)};
    const QString settings = In(u"config/tunestead.conf"_s);
    ScriptedDialogs dialogs;
    RecordingTrash trash;
    trash.Removes = true;
    trash.Refused = u".conf"_s;
    InstallationSteps steps(&installation_, files, settings);
    complaint_ = u"xdg-mime: kaputt"_s;
    steps.Install({});
    ASSERT_EQ(dialogs.Messages.size(), 1);
    EXPECT_TRUE(dialogs.Messages[0].contains(complaint_));
    Write(u"data/tunestead/Tunestead3_Database.tsdb"_s, "songs");
    Write(u"data/tunestead/Tunestead3_BannList.str"_s, "A - 1");
    Write(u"config/tunestead.conf"_s, "[settings]");
    const QStringList before = Files();

    dialogs.Answers = {kNo};
    steps.Uninstall({});
    EXPECT_EQ(Files(), before);
    EXPECT_FALSE(steps.Removed().Program);

    dialogs.Questions.clear();
    dialogs.Answers = {kYes, kYes, kNo, kYes};
    EXPECT_TRUE(ErrorOf([&] { steps.Uninstall({}); }).contains(settings));
    EXPECT_EQ(dialogs.Questions.value(1), u"Soll die Datenbank ebenfalls entfernt werden?"_s);
    EXPECT_EQ(dialogs.Questions.size(), 4);
    EXPECT_EQ(trash.Taken, QStringList{files.Database()});
    EXPECT_EQ(Files(),
              QStringList({u"config/tunestead.conf"_s, u"data/tunestead/Tunestead3_BannList.str"_s}));
    EXPECT_TRUE(steps.Removed().Program && steps.Removed().Database);
    EXPECT_FALSE(steps.Removed().Lists || steps.Removed().Settings);
}

}  // namespace
