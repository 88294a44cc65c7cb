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
#include "tests/app/ScriptedDialogs.h"

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
    const QStringList buttons = {u"Ja"_s, u"Nein"_s, u"Abbrechen"_s};
    QStringList seen;
    WithNextDialog<QMessageBox>([&](QMessageBox& box) {
        seen = Captions(box);
        EXPECT_EQ(box.text(), u"Laden:\n<b>.tsdb"_s);
        EXPECT_EQ(box.textFormat(), Qt::PlainText);
        QTest::mouseClick(box.buttons().at(1), Qt::LeftButton);
    });
    const int answer = dialogs.Ask(u"Laden:\r\n<b>.tsdb"_s, buttons, 2);
    EXPECT_EQ(seen, QStringList({u"Abbrechen"_s, u"Ja"_s, u"Nein"_s}));
    EXPECT_NE(answer, -1);
}

TEST(QtDialogs, EachButtonAnswersWithItsPlaceAndEscapeCancels) {
    QtDialogs dialogs;
    const QStringList buttons = {u"Ja"_s, u"Nein"_s, u"Abbrechen"_s};
    for (int i = 0; i < 3; ++i) {
        WithNextDialog<QMessageBox>([&](QMessageBox& box) {
            for (QAbstractButton* button : box.buttons())
                if (button->text().remove(u'&') == buttons[i]) return button->click();
        });
        EXPECT_EQ(dialogs.Ask(u"?"_s, buttons, 2), i);
    }
    WithNextDialog<QMessageBox>([](QMessageBox& box) { QTest::keyClick(&box, Qt::Key_Escape); });
    EXPECT_EQ(dialogs.Ask(u"?"_s, {u"Ja"_s, u"Nein"_s}, 1), 1);
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
