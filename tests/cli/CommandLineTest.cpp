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
        {u"scan --db a"_s, u"PFAD fehlt."_s, u"tunestead-cli scan --help"_s},
        {u"list --db a b"_s, u"Überzähliges Argument: b"_s, u"tunestead-cli list --help"_s},
        {u"list --db a --sort title"_s, u"Unbekannter Wert für --sort: title."_s, u"stTitle, stArtist"_s},
    };
    for (const auto& test : cases) {
        const auto result = RunWords(test.words.split(u' ', Qt::SkipEmptyParts));
        EXPECT_EQ(result.Status, esWrongUsage) << test.words.toStdString();
        EXPECT_TRUE(result.Err.startsWith(test.message)) << result.Err.toStdString();
        EXPECT_TRUE(result.Err.contains(test.hint)) << result.Err.toStdString();
        EXPECT_EQ(result.Out, QString());
    }
}

TEST(CommandLine, HelpIsForTheProgramAndForEachCommand) {
    for (const auto& [words, told] :
         {std::pair{u"--help"_s, u"playlist"_s}, {u"scan --help"_s, u"PFAD…"_s}}) {
        const auto result = RunWords(words.split(u' '));
        EXPECT_EQ(result.Status, esDone);
        EXPECT_TRUE(result.Out.contains(told)) << words.toStdString();
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
