#include "app/dialogs/wizard/WizardForm.h"

#include <gtest/gtest.h>

#include <QCheckBox>
#include <QFileInfo>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QRadioButton>
#include <QTemporaryDir>
#include <QTest>

#include "CommonRUKTools/MusicFolder.h"
#include "MusicManagment/database/MusicManagment.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/app/LabelFit.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kPages = 4;

class WizardFormTest : public testing::Test {
 protected:
    void Open(const WizardChoice& start) {
        wizard_ = std::make_unique<TWizardForm>(start);
        wizard_->show();
    }
    WizardChoice Start() const { return {{u"/musik"_s}, false, folder_.path(), u"%ARTIST% - %TITLE%"_s}; }
    // As a user goes on with the keyboard.
    void Return() { QTest::keyClick(wizard_.get(), Qt::Key_Return); }
    void GoTo(int page) {
        while (Page() < page)
            wizard_->next();
    }
    int Page() const { return static_cast<int>(wizard_->visitedIds().size()) - 1; }
    template <typename T>
    T& Child(const QString& name) {
        T* child = wizard_->findChild<T*>(name);
        EXPECT_NE(child, nullptr) << name.toStdString();
        return *child;
    }

    QTemporaryDir folder_;
    ScriptedDialogs dialogs_;
    std::unique_ptr<TWizardForm> wizard_;
};

TEST_F(WizardFormTest, ReturnLeadsThroughAndSearchesWhereThereAreFolders) {
    WizardChoice nowhere = Start();
    nowhere.Folders.clear();
    Open(nowhere);
    GoTo(3);
    Return();
    EXPECT_EQ(wizard_->result(), QDialog::Accepted);
    EXPECT_FALSE(wizard_->Choice().ScanNow);

    Open(Start());
    for (int page = 1; page < kPages; ++page) {
        Return();
        EXPECT_EQ(Page(), page);
    }
    EXPECT_EQ(wizard_->buttonText(QWizard::FinishButton), u"&Fertig"_s);
    Return();
    EXPECT_EQ(wizard_->result(), QDialog::Accepted);
    EXPECT_EQ(wizard_->Choice().Folders, QStringList{u"/musik"_s});
    EXPECT_FALSE(wizard_->Choice().RenameAndMove);
    EXPECT_TRUE(wizard_->Choice().ScanNow);
}

TEST_F(WizardFormTest, TheChoicesAreSummedUpAndHandedBack) {
    Open(Start());
    GoTo(1);
    dialogs_.Folders = {u"/hörspiele"_s};
    Child<QPushButton>(u"addFolder"_s).click();
    GoTo(2);
    Child<QRadioButton>(u"rename"_s).setChecked(true);
    Child<QLineEdit>(u"pattern"_s).setText(u"%ALBUM% - %TRACKNR%"_s);
    EXPECT_EQ(Child<QLabel>(u"example"_s).text(), u"Beispiel: Sommer - 4.mp3"_s);
    const auto place = [this] { return Child<QLabel>(u"placeExample"_s).text().remove(QChar(0x200B)); };
    const QString folder = QFileInfo(MusicFolder()).absoluteFilePath() + u"/Sommer"_s;
    EXPECT_EQ(place(), u"Beispiel: Aus %1/lied04.mp3 wird %1/Sommer - 4.mp3"_s.arg(folder));
    Child<QCheckBox>(u"KeepFolders"_s).click();
    EXPECT_TRUE(place().endsWith(u"wird "_s + folder_.path() + folder + u"/Sommer - 4.mp3"_s))
        << place().toStdString();
    GoTo(3);
    QString summary = Child<QLabel>(u"summary"_s).text();
    EXPECT_EQ(summary.remove(QChar(0x200B)),
              u"Nach Songs durchsucht werden mit ihren Unterordnern:\n    /musik\n    /hörspiele\n\nDateien "
              "werden nach diesem Muster benannt, wenn sich ihre Tags ändern:\n    %ALBUM% - %TRACKNR%\nund "
              "liegen dann nach Genres geordnet in:\n    "_s +
                  folder_.path() + u"\nDateien ohne Genre kommen mit ihrem alten Pfad dorthin."_s);
    EXPECT_FALSE(wizard_->Choice().RenameInPlace);
    Child<QCheckBox>(u"scanNow"_s).setChecked(false);
    Return();
    EXPECT_EQ(wizard_->Choice().Folders, QStringList({u"/musik"_s, u"/hörspiele"_s}));
    EXPECT_TRUE(wizard_->Choice().RenameAndMove);
    EXPECT_EQ(wizard_->Choice().RootFolder, folder_.path());
    EXPECT_EQ(wizard_->Choice().Pattern, u"%ALBUM% - %TRACKNR%"_s);
    EXPECT_FALSE(wizard_->Choice().ScanNow);
}

TEST_F(WizardFormTest, RenamingNeedsAFolderAndAPattern) {
    Open(Start());
    GoTo(2);
    Child<QLineEdit>(u"pattern"_s).clear();
    Child<QRadioButton>(u"rename"_s).setChecked(true);
    Return();
    EXPECT_EQ(Page(), 2);
    EXPECT_EQ(dialogs_.Messages, QStringList{u"Das Muster für die Dateinamen ist leer."_s});
    EXPECT_EQ(wizard_->focusWidget(), &Child<QLineEdit>(u"pattern"_s));
    Child<QLineEdit>(u"pattern"_s).setText(u"%TITLE%"_s);
    Child<QLineEdit>(u"folder"_s).setText(folder_.filePath(u"neu"_s));
    Return();
    EXPECT_EQ(Page(), 2);
    EXPECT_EQ(dialogs_.Questions.size(), 1);
    Child<QRadioButton>(u"keep"_s).setChecked(true);
    Return();
    EXPECT_EQ(Page(), 3);
}

TEST_F(WizardFormTest, ALongPathOrPatternDoesNotWidenTheWindow) {
    WizardChoice start = Start();
    start.Folders = {QString(u"/sehrlangerordner"_s).repeated(40)};
    start.Pattern = QString(u"%TITLE%"_s).repeated(30).remove(u' ');
    start.RenameAndMove = true;
    Open(start);
    const int width = wizard_->width();
    for (int page = 0; page < kPages; ++page) {
        GoTo(page);
        QApplication::processEvents();
        EXPECT_EQ(wizard_->width(), width);
    }
}

TEST_F(WizardFormTest, NothingIsClippedAndEveryKeyIsUniqueInAnyFontSize) {
    WithEveryFontSize([this](int size) {
        Open(Start());
        for (int page = 0; page < kPages; ++page) {
            GoTo(page);
            QApplication::processEvents();
            EXPECT_EQ(ClippedCaptions(*wizard_), QStringList()) << size << " pt, page " << page;
            EXPECT_EQ(AmbiguousKeys(*wizard_), QStringList()) << "page " << page;
        }
        EXPECT_LE(wizard_->height(), 720);
    });
}

TEST(WizardChoice, IsAppliedToTheDatabase) {
    TMusicDatabase database;
    const QString pattern = database.MP3NamePattern();
    ApplyChoice({{u"/musik"_s}, false, u"/anderswo"_s, u"%TITLE%"_s}, database);
    EXPECT_EQ(database.UpdateFolders(), QStringList{u"/musik"_s});
    EXPECT_TRUE(database.Modified());
    EXPECT_FALSE(database.RenameAndMoveMP3s() || database.MoveMP3sAfterGenreChange());
    EXPECT_EQ(database.MP3NamePattern(), pattern);

    database.SetModified(false);
    ApplyChoice({{u"/musik"_s}, true, u"/anderswo"_s, u"%TITLE%"_s}, database);
    EXPECT_FALSE(database.Modified());
    EXPECT_TRUE(database.RenameAndMoveMP3s() && database.MoveMP3sAfterGenreChange());
    EXPECT_EQ(database.MP3MoveRootDir(), u"/anderswo/"_s);
    EXPECT_EQ(database.MP3NamePattern(), u"%TITLE%"_s);
}

}  // namespace
