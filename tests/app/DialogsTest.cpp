#include <gtest/gtest.h>

#include <QAbstractButton>
#include <QApplication>
#include <QFileDialog>
#include <QInputDialog>
#include <QMainWindow>
#include <QMessageBox>
#include <QPushButton>
#include <QStatusBar>
#include <QTabWidget>
#include <QTemporaryDir>
#include <QTest>
#include <QTimer>
#include <QToolButton>
#include <new>

#include "CommonRUKTools/CommandRunner.h"
#include "CommonRUKTools/Errors.h"
#include "app/dialogs/FileFilters.h"
#include "app/dialogs/QtDialogs.h"
#include "app/dialogs/ReportDisplay.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/ScriptedVolumes.h"

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

TEST(QtDialogs, AQuestionShowsPlainTextAndButtonsWithLetters) {
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
    const auto press = [](Qt::Key key) {
        return [key](QMessageBox& box) { QTest::keyClick(box.focusWidget(), key); };
    };
    for (int i = 0; i < question.Buttons.size(); ++i)
        EXPECT_EQ(answerTo([&](QMessageBox& box) {
                      for (QAbstractButton* button : box.buttons())
                          if (button->text().remove(u'&') == question.Buttons[i]) return button->click();
                  }),
                  i);
    EXPECT_EQ(answerTo(press(Qt::Key_Return)), 2) << "without a default Return destroys nothing";
    question.Default = 1;
    EXPECT_EQ(answerTo(press(Qt::Key_Return)), 1);
    EXPECT_EQ(answerTo(press(Qt::Key_Escape)), 2);
}

TEST(QtDialogs, TheChoiceOfAVolumeGoesToWhatIsPluggedIn) {
    ScriptedVolumes volumes;
    volumes.Mount(u"/"_s, 1);
    volumes.Now[0].Removable = false;
    QtDialogs dialogs;
    WithNextDialog<QInputDialog>([&](QInputDialog& dialog) {
        EXPECT_EQ(dialog.textValue(), u"/"_s);
        volumes.Mount(u"/media/a"_s, 2, u"STICK"_s);
        volumes.Changed.Tell();
        EXPECT_EQ(dialog.comboBoxItems(), (QStringList{u"STICK (/media/a)"_s, u"/"_s}));
        dialog.accept();
    });
    EXPECT_EQ(dialogs.ChooseVolume(u"Urlaub"_s, {}, {}), u"/media/a"_s);
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

TEST(ReportDisplay, OnlyComplaintsOpenAWindow) {
    QMainWindow window;
    ReportDisplay display;
    Report report;
    report.Message = u"2 neue\nSongs"_s;
    report.Sections = {{u"Neu & gut"_s, {u"a"_s, u"b"_s}}};
    const auto pages = [&] {
        QStringList captions;
        for (const auto* tabs : window.findChildren<QTabWidget*>())
            for (int page = 0; page < tabs->count(); ++page)
                captions << tabs->tabText(page) + (page == tabs->currentIndex() ? u"*"_s : QString());
        return captions;
    };
    window.show();
    display.Show(report, &window);
    EXPECT_EQ(window.statusBar()->currentMessage(), u"2 neue Songs"_s);
    EXPECT_EQ(pages(), QStringList());
    auto* details = window.findChild<QToolButton*>(u"reportDetails"_s);
    details->click();
    EXPECT_EQ(pages(), QStringList{u"Neu && gut (2)*"_s});

    bool opened = false;
    report.Sections.push_back({u"Beschädigt"_s, {u"c"_s}, true});
    report.OpenAsText = [&] { opened = true; };
    display.Show(report, &window);
    EXPECT_EQ(pages(), QStringList({u"Neu && gut (2)"_s, u"Beschädigt (1)*"_s}));
    for (auto* button : window.findChildren<QPushButton*>())
        if (button->text() == u"Als &Text öffnen"_s) button->click();
    EXPECT_TRUE(opened);
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
