#include "cli/TerminalDialogs.h"

#include <gtest/gtest.h>

#include "tests/PrintQt.h"
#include "tests/cli/CommandRunner.h"

using namespace Qt::StringLiterals;

namespace {

class TerminalDialogsTest : public testing::Test {
 protected:
    void Answer(const char* text) {
        std::fputs(text, answers_.get());
        std::rewind(answers_.get());
    }

    TemporaryStream questions_{std::tmpfile()};
    TemporaryStream answers_{std::tmpfile()};
    TerminalDialogs dialogs_{questions_.get(), answers_.get()};
};

}  // namespace

TEST_F(TerminalDialogsTest, AnswersAreNumbersOfAList) {
    Answer("2\r\n7\nx\n\n1\n");
    const QStringList buttons = {u"Ja"_s, u"Nein"_s, u"Abbrechen"_s};
    const Question question = {.Text = u"Weiter?"_s, .Buttons = buttons, .Cancel = 2, .Default = 0};
    for (const int answer : {1, 2, 2, 0})
        EXPECT_EQ(dialogs_.Ask(question), answer);
    EXPECT_EQ(dialogs_.Input(u"Genre"_s, u"Welches"_s, buttons, {}), u"Ja"_s);
    EXPECT_TRUE(Contents(questions_.get()).contains("Weiter?\n  1) Ja\n  2) Nein\n  3) Abbrechen\n"));
}

TEST_F(TerminalDialogsTest, AnEmptyAnswerTakesThePreset) {
    const QByteArray longName(2000, 'n');
    Answer(("\n" + longName + "\nÄ").constData());
    EXPECT_EQ(dialogs_.Input(u"Name"_s, u"Name"_s, {}, u"vorher"_s), u"vorher"_s);
    EXPECT_EQ(dialogs_.Input(u"Name"_s, u"Name"_s, {}, u"vorher"_s), QString::fromLatin1(longName));
    EXPECT_EQ(dialogs_.ChooseFolder(u"Ordner"_s, {}), u"Ä"_s);
    EXPECT_EQ(dialogs_.ChooseFolder(u"Ordner"_s, {}), std::nullopt);
}

TEST_F(TerminalDialogsTest, WithoutATerminalEveryQuestionIsCancelled) {
    TerminalDialogs dialogs(questions_.get(), nullptr);
    EXPECT_EQ(dialogs.Ask({.Text = u"?"_s, .Buttons = {u"Ja"_s, u"Nein"_s}, .Cancel = 1, .Default = 0}), 1);
    EXPECT_EQ(dialogs.Input(u"?"_s, u"?"_s, {}, u"preset"_s), std::nullopt);
    EXPECT_TRUE(dialogs.OpenFiles({}).isEmpty());
    EXPECT_EQ(dialogs.OpenFile({}), std::nullopt);
}

TEST_F(TerminalDialogsTest, AFileIsReplacedOnlyAfterAYes) {
    const SongFolder folder;
    const QString path = folder.Put(u"a"_s, "");
    FileDialogOptions options;
    options.Preset = path;
    options.ConfirmOverwrite = true;
    Answer("\n2\n\n1\n");
    EXPECT_EQ(dialogs_.SaveFile(options), std::nullopt);
    EXPECT_EQ(dialogs_.SaveFile(options), path);
}
