#include "cli/CommandLine.h"

#include <gtest/gtest.h>

#include "cli/platform/Terminal.h"
#include "tests/PrintQt.h"
#include "tests/cli/CommandRunner.h"

using namespace Qt::StringLiterals;

TEST(CommandLine, WrongUsageIsNamedWithWhereTheHelpIs) {
    struct Case {
        QString words;  // parted by blanks
        QString message;
        QString hint;
    };
    const Case cases[] = {
        {u""_s, u"Es fehlt ein Befehl."_s, u"tunestead-cli --help"_s},
        {u"sing x"_s, u"Unbekannter Befehl: sing"_s, u"tunestead-cli --help"_s},
        {u"--verbose"_s, u"Unbekannter Befehl: --verbose"_s, u"tunestead-cli --help"_s},
        {u"info"_s, u"DATEI fehlt."_s, u"tunestead-cli info --help"_s},
        {u"info --nix=3 a"_s, u"Unbekannte Option: --nix"_s, u"tunestead-cli info --help"_s},
        {u"info --json=yes a"_s, u"Die Option --json hat keinen Wert."_s, u"tunestead-cli info --help"_s},
        {u"scan a"_s, u"Die Option --db fehlt."_s, u"tunestead-cli scan --help"_s},
        {u"scan a --db"_s, u"Die Option --db braucht einen Wert."_s, u"tunestead-cli scan --help"_s},
        {u"scan a --db="_s, u"Die Option --db braucht einen Wert."_s, u"tunestead-cli scan --help"_s},
        {u"scan --db a"_s, u"PFAD fehlt."_s, u"tunestead-cli scan --help"_s},
        {u"list --db a b"_s, u"Überzähliges Argument: b"_s, u"tunestead-cli list --help"_s},
        {u"list --db a --sort title"_s, u"Unbekannter Wert für --sort: title."_s, u"stTitle, stArtist"_s},
        {u"list --db a --subsort x"_s, u"Unbekannter Wert für --subsort: x."_s,
         u"sstGATL, sstATL, sstPath"_s},
        {u"groups --db a"_s, u"Die Option --by fehlt."_s, u"tunestead-cli groups --help"_s},
        {u"groups --db a --by song"_s, u"Unbekannter Wert"_s, u"artist, album, year, length, genre"_s},
        {u"save --db a"_s, u"Die Option --out fehlt."_s, u"tunestead-cli save --help"_s},
        {u"save --db a --out b --compression 9"_s, u"Unbekannter Wert"_s, u"none, fastest, default, max"_s},
    };
    for (const auto& test : cases) {
        const auto result = RunWords(test.words.split(u' ', Qt::SkipEmptyParts));
        EXPECT_EQ(result.Status, esWrongUsage) << test.words.toStdString();
        EXPECT_TRUE(result.Err.startsWith(test.message)) << result.Err.toStdString();
        EXPECT_TRUE(result.Err.contains(test.hint)) << result.Err.toStdString();
        EXPECT_EQ(result.Out, QString());
    }
}

TEST(CommandLine, HelpNamesEveryCommandAndEachOfItsOptions) {
    const std::pair<QString, QStringList> cases[] = {
        {u""_s, {u"info"_s, u"scan"_s, u"list"_s, u"groups"_s, u"save"_s, u"playlist"_s, u"play"_s}},
        {u"info"_s, {u"--json"_s, u"--classic"_s, u"--frames"_s, u"DATEI…"_s}},
        {u"scan"_s, {u"--db DATENBANK"_s, u"--no-subfolders"_s, u"--classic"_s, u"--json"_s, u"PFAD…"_s}},
        {u"list"_s, {u"--db"_s, u"--sort"_s, u"--subsort"_s, u"--backwards"_s, u"--json"_s}},
        {u"groups"_s, {u"--db"_s, u"--by"_s, u"--json"_s}},
        {u"save"_s, {u"--db"_s, u"--out"_s, u"--compression"_s}},
    };
    for (const auto& [command, words] : cases) {
        const auto result = RunWords((command + u" --help"_s).split(u' ', Qt::SkipEmptyParts));
        EXPECT_EQ(result.Status, esDone);
        for (const auto& word : words)
            EXPECT_TRUE(result.Out.contains(word)) << word.toStdString();
    }
}

#ifdef Q_OS_UNIX
TEST_F(CommandTest, AReaderThatLeavesEndsTheCommandQuietly) {
    PrepareConsole();
    std::FILE* pipe = popen("exec true", "w");
    const TemporaryStream err(std::tmpfile());
    QStringList words{u"info"_s, u"--json"_s};
    words += QStringList(1000, PutWave(u"a.wav"_s));  // more than a pipe holds
    EXPECT_EQ(RunCommand(words, {pipe, err.get()}), esDone);
    EXPECT_EQ(Contents(err.get()), "");
    pclose(pipe);
}
#endif

TEST_F(CommandTest, AnOutputThatCannotBeWrittenIsAFailure) {
    const TemporaryStream full(std::fopen("/dev/full", "w"));
    if (!full) GTEST_SKIP() << "no device that is always full";
    const TemporaryStream err(std::tmpfile());
    EXPECT_EQ(RunCommand({u"info"_s, PutWave(u"a.wav"_s)}, {full.get(), err.get()}), esFailed);
    EXPECT_TRUE(Contents(err.get()).startsWith("Die Ausgabe konnte nicht geschrieben werden"));
}
