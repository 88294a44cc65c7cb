#include <gtest/gtest.h>

#include <QAbstractButton>
#include <QApplication>
#include <QFileDialog>
#include <QMessageBox>
#include <QTemporaryDir>
#include <QTest>
#include <QTimer>
#include <new>

#include "CommonRUKTools/Errors.h"
#include "app/CommandRunner.h"
#include "app/dialogs/FileFilters.h"
#include "app/dialogs/QtDialogs.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"

using namespace Qt::StringLiterals;

namespace {

// Does something with the dialog that opens next.
template <typename Box>
void WithNextDialog(std::function<void(Box&)> action) {
    QTimer::singleShot(0, [action] {
        auto* box = qobject_cast<Box*>(QApplication::activeModalWidget());
        ASSERT_NE(box, nullptr);
        action(*box);
    });
}

QStringList Captions(const QWidget& window) {
    QStringList captions;
    for (const auto* button : window.findChildren<QAbstractButton*>())
        if (button->isVisible() && !button->text().isEmpty()) captions << button->text().remove(u'&');
    captions.sort();
    return captions;
}

TEST(QtDialogs, AQuestionShowsPlainTextAndItsOwnButtons) {
    QtDialogs dialogs;
    QStringList captions;
    WithNextDialog<QMessageBox>([&](QMessageBox& box) {
        for (const QAbstractButton* button : box.buttons())
            captions << button->text();
        captions.sort();
        EXPECT_EQ(box.text(), u"Laden:\n<b>.tsdb"_s);
        EXPECT_EQ(box.textFormat(), Qt::PlainText);
        box.reject();
    });
    dialogs.Ask({.Text = u"Laden:\r\n<b>.tsdb"_s, .Buttons = {u"Alle"_s, u"Auch"_s, u"Um & Au"_s}});
    EXPECT_EQ(captions, QStringList({u"&Alle"_s, u"A&uch"_s, u"U&m && Au"_s}));
}

TEST(QtDialogs, EachButtonAnswersWithItsPlaceReturnWithTheDefaultAndEscapeCancels) {
    QtDialogs dialogs;
    Question question = {
        .Text = u"?"_s, .Buttons = {u"Entfernen"_s, u"Behalten"_s, u"Abbrechen"_s}, .Cancel = 2};
    const auto answerTo = [&](const std::function<void(QMessageBox&)>& action) {
        WithNextDialog<QMessageBox>(action);
        return dialogs.Ask(question);
    };
    const auto key = [](Qt::Key key) {
        return [key](QMessageBox& box) { QTest::keyClick(box.focusWidget(), key); };
    };
    for (int i = 0; i < question.Buttons.size(); ++i)
        EXPECT_EQ(answerTo([&](QMessageBox& box) {
                      for (QAbstractButton* button : box.buttons())
                          if (button->text().remove(u'&') == question.Buttons[i]) return button->click();
                  }),
                  i);
    EXPECT_EQ(answerTo(key(Qt::Key_Return)), 2) << "without a default Return destroys nothing";
    question.Default = 1;
    EXPECT_EQ(answerTo(key(Qt::Key_Return)), 1);
    EXPECT_EQ(answerTo(key(Qt::Key_Escape)), 2);
}

TEST(QtDialogs, FileDialogsSpeakGerman) {
    const QTemporaryDir folder;
    QtDialogs dialogs;
    FileDialogOptions options;
    options.Title = u"Datenbank speichern unter"_s;
    options.DefaultExtension = u"tsdb"_s;
    options.Filter = u"Tunestead DataBases|*.tsdb|Alle Dateien|*.*"_s;
    options.Preset = folder.filePath(u"neu.tsdb"_s);
    options.ConfirmOverwrite = true;
    QStringList seen;
    WithNextDialog<QFileDialog>([&](QFileDialog& dialog) {
        seen = Captions(dialog);
        dialog.reject();
    });
    EXPECT_FALSE(dialogs.SaveFile(options));
    EXPECT_TRUE(seen.contains(u"Speichern"_s));
    EXPECT_TRUE(seen.contains(u"Abbrechen"_s));
    for (const QString& english : {u"Save"_s, u"Open"_s, u"Cancel"_s, u"Choose"_s})
        EXPECT_FALSE(seen.contains(english)) << english.toStdString();
}

TEST(QtDialogs, AFolderIsChosenFromWhereTheCommandSays) {
    const QTemporaryDir folder;
    QtDialogs dialogs;
    QString shown;
    WithNextDialog<QFileDialog>([&](QFileDialog& dialog) {
        shown = dialog.directory().absolutePath();
        dialog.reject();
    });
    EXPECT_FALSE(dialogs.ChooseFolder(u"Ordner"_s, folder.path()));
    EXPECT_EQ(shown, folder.path());
}

TEST(FileFilters, BecomeNameFilters) {
    const std::pair<QString, QStringList> cases[] = {
        {u"Tunestead DataBases|*.tsdb|Alle Dateien|*.*"_s,
         {u"Tunestead DataBases (*.tsdb *.TSDB)"_s, u"Alle Dateien (*)"_s}},
        {u"Musik|*.mp3;*.wav;|Alle Dateien|*.*"_s,
         {u"Musik (*.mp3 *.MP3 *.wav *.WAV)"_s, u"Alle Dateien (*)"_s}},
        {u"Ohne Muster"_s, {}},
        {u"Leer||Texte|*.1"_s, {u"Texte (*.1)"_s}},
        {QString(), {}},
    };
    for (const auto& [filter, expected] : cases)
        EXPECT_EQ(NameFilters(filter), expected) << filter.toStdString();
}

TEST(CommandRunner, ShowsWhatACommandThrows) {
    ScriptedDialogs dialogs;
    RunCommand([] { throw EStreamError(u"Datei kaputt"_s); });
    RunCommand([] { throw EAbort(); });
    RunCommand([] { throw std::bad_alloc(); });
    RunCommand([] { throw std::runtime_error("seltsam"); });
    EXPECT_EQ(dialogs.Messages,
              QStringList({u"Datei kaputt"_s, u"Der Arbeitsspeicher reicht für diese Aktion nicht aus."_s,
                           u"Unerwarteter Fehler: seltsam"_s}));
}

}  // namespace
