#include "app/dialogs/options/OptionsForm.h"

#include <gtest/gtest.h>

#include <QCheckBox>
#include <QComboBox>
#include <QDir>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QRadioButton>
#include <QSpinBox>
#include <QTableWidget>
#include <QTemporaryDir>
#include <QTest>

#include "CommonRUKTools/RWReg.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/songfiles/NamePattern.h"
#include "MusicManagment/playback/fmod/FmodLibrary.h"
#include "MusicManagment/playlist/PlayList.h"
#include "app/dialogs/NamePatternTexts.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/app/LabelFit.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kTabs = 9;

class OptionsFormTest : public testing::Test {
 protected:
    OptionsFormTest() : settings_(u"\\Test"_s, folder_.filePath(u"test.conf"_s)) {
        database_.SetMP3MoveRootDir(folder_.path());
    }

    void Open() {
        form_ = std::make_unique<TOptionsForm>(database_, settings_);
        form_->show();
        ASSERT_TRUE(QTest::qWaitForWindowActive(form_.get()));
    }
    void LinkPlayer() {
        database_.SetPlaySound(&player_);
        database_.SetPlayList(&player_);
        database_.SetRemoteControl(&player_);
    }
    // Within the field of this name, when the widget has parts.
    template <typename T>
    T& Field(const QString& name, const QString& part = QString()) {
        QWidget* whole = form_->findChild<QWidget*>(name);
        T* field = part.isEmpty() ? qobject_cast<T*>(whole) : whole->findChild<T*>(part);
        EXPECT_NE(field, nullptr) << name.toStdString();
        return *field;
    }
    void Click(const QString& button) { Field<QPushButton>(button).click(); }
    QString Example() { return Field<QLabel>(u"MP3NamePattern"_s, u"example"_s).text(); }
    QLineEdit& Pattern() { return Field<QLineEdit>(u"MP3NamePattern"_s, u"pattern"_s); }
    QLineEdit& Root() { return Field<QLineEdit>(u"MP3MoveRootDir"_s, u"folder"_s); }
    OptionsTab Tab() { return static_cast<OptionsTab>(Field<QListWidget>(u"pages"_s).currentRow()); }

    QTemporaryDir folder_;
    ScriptedDialogs dialogs_;
    TMusicDatabase database_;
    QObject player_;
    TRWReg settings_;
    std::unique_ptr<TOptionsForm> form_;
};

TEST_F(OptionsFormTest, OkStoresEveryKindOfValueWithItsType) {
    LinkPlayer();
    int applied = 0;
    settings_.WriteInteger(u"FMODSoundOutput"_s, 99);  // none of the outputs; nobody touches it
    Open();
    form_->OnApplied = [&applied] { ++applied; };
    EXPECT_EQ(Field<QComboBox>(u"FMODSoundOutput"_s).currentIndex(), FSOUND_OUTPUT_DSOUND);
    EXPECT_FALSE(Field<QPushButton>(u"apply"_s).isEnabled());
    Field<QComboBox>(u"AutoSave"_s).setCurrentIndex(2);
    Field<QSpinBox>(u"AutoSaveInterval"_s).setValue(90'000);
    EXPECT_EQ(Field<QSpinBox>(u"AutoSaveInterval"_s).text(), u"1,5 min"_s);
    Field<QComboBox>(u"SortType"_s).setCurrentIndex(stAlbum);
    Field<QCheckBox>(u"SortBackwards"_s).setChecked(true);
    Field<QTableWidget>(u"MP3MoveSubDirs"_s).item(3, 1)->setText(u"Deutschrock"_s);
    Field<QCheckBox>(u"UseFMOD"_s).setChecked(false);
    Field<QSpinBox>(u"ScanTime"_s).setValue(7500);
    Field<QLineEdit>(u"WinAmpFileName"_s).setText(u"winamp5.exe"_s);
    Click(u"ok"_s);

    EXPECT_EQ(form_->result(), QDialog::Accepted);
    EXPECT_EQ(applied, 1);
    EXPECT_EQ(database_.AutoSave(), 90'000);
    EXPECT_EQ(database_.Order(), (SongOrder{stAlbum, sstGATL, true}));
    EXPECT_EQ(database_.MP3MoveSubDirs().at(3), u"Deutschrock"_s);
    const TRWReg stored(u"\\Test"_s, folder_.filePath(u"test.conf"_s));
    EXPECT_EQ(stored.ReadInteger(u"AutoSave"_s), 90'000);
    EXPECT_EQ(stored.ReadBool(u"UseFMOD"_s), false);
    EXPECT_EQ(stored.ReadInteger(u"ScanTime"_s), 7500);
    EXPECT_EQ(stored.ReadString(u"WinAmpFileName"_s), u"winamp5.exe"_s);
    EXPECT_EQ(stored.ReadInteger(u"FMODSoundOutput"_s), 99);
    EXPECT_FALSE(stored.Exists(u"UseMCI"_s));
    EXPECT_FALSE(database_.Modified());  // none of this is in the database's file
}

TEST_F(OptionsFormTest, RulesAreChosenTogetherOrOneByOne) {
    Open();
    form_->ShowTab(OptionsTab::Rules);
    EXPECT_TRUE(Field<QRadioButton>(u"ClassicRules"_s).isChecked());
    auto& tags = Field<QCheckBox>(u"ModernTags"_s);
    EXPECT_FALSE(tags.isEnabled());
    Field<QRadioButton>(u"ModernRules"_s).click();
    EXPECT_TRUE(tags.isChecked());
    EXPECT_TRUE(Field<QCheckBox>(u"KeepFolders"_s).isChecked());  // the same on the page of the files
    EXPECT_TRUE(form_->Apply());
    EXPECT_TRUE(database_.ModernTags() && database_.RenameInPlace());
    Field<QRadioButton>(u"SingleRules"_s).click();
    EXPECT_TRUE(tags.isEnabled());
    tags.click();
    EXPECT_TRUE(form_->Apply());
    EXPECT_FALSE(database_.ModernTags());
    Click(u"defaults"_s);
    EXPECT_TRUE(Field<QRadioButton>(u"ModernRules"_s).isChecked());
}

TEST_F(OptionsFormTest, ApplyStoresAndStaysAndRests) {
    Open();
    Field<QComboBox>(u"AutoSave"_s).setCurrentIndex(1);
    EXPECT_TRUE(Field<QPushButton>(u"apply"_s).isEnabled());
    Click(u"apply"_s);
    EXPECT_TRUE(form_->isVisible());
    EXPECT_EQ(database_.AutoSave(), -1);
    EXPECT_FALSE(Field<QPushButton>(u"apply"_s).isEnabled());
    EXPECT_EQ(Tab(), OptionsTab::General);
    QTest::keyClick(&Field<QListWidget>(u"pages"_s), Qt::Key_Down);
    EXPECT_EQ(Tab(), OptionsTab::Database);
    QTest::keyClick(&Field<QListWidget>(u"pages"_s), Qt::Key_Return);
    EXPECT_EQ(form_->result(), QDialog::Accepted);
}

TEST_F(OptionsFormTest, ComponentsTellWhatIsInForceAndReadWhatWasChosen) {
    TPlayList list;
    list.SetMusicDatabase(&database_);
    list.SetRepeatAll(true);
    settings_.WriteBool(u"RepeatAll"_s, false);
    Open();
    EXPECT_TRUE(Field<QCheckBox>(u"RepeatAll"_s).isChecked());
    Field<QCheckBox>(u"RepeatAll"_s).setChecked(false);
    EXPECT_TRUE(form_->Apply());
    EXPECT_FALSE(list.RepeatAll());
    EXPECT_EQ(settings_.ReadBool(u"RepeatAll"_s), false);
}

TEST_F(OptionsFormTest, GroupsOfMissingComponentsAreGrey) {
    Open();
    EXPECT_FALSE(Field<QCheckBox>(u"UseFMOD"_s).isEnabled());
    EXPECT_EQ(Field<QCheckBox>(u"UseFMOD"_s).toolTip(), u"Wird mit dem Player wirksam."_s);
    LinkPlayer();
    Open();
    EXPECT_TRUE(Field<QCheckBox>(u"UseFMOD"_s).isEnabled());
}

// --- Faults ---

TEST_F(OptionsFormTest, ThePatternMustGiveNames) {
    Open();
    const std::pair<QString, QString> cases[] = {
        {u"   "_s, u"Das Muster für die Dateinamen ist leer."_s},
        {u"Lied"_s,
         u"Das Muster für die Dateinamen enthält keinen Platzhalter: alle Songs bekämen denselben Namen."_s},
        {u"%ARTIST% - %Titel%"_s,
         u"Den Platzhalter %Titel% im Muster für die Dateinamen gibt es nicht. "
         "Platzhalter werden groß geschrieben."_s}};
    for (const auto& [pattern, message] : cases) {
        form_->ShowTab(OptionsTab::General);
        Pattern().setText(pattern);
        dialogs_.Messages.clear();
        Click(u"ok"_s);
        EXPECT_TRUE(form_->isVisible());
        EXPECT_EQ(dialogs_.Messages, QStringList{message});
        EXPECT_EQ(Example(), message);
        EXPECT_EQ(Tab(), OptionsTab::Files);
        EXPECT_EQ(form_->focusWidget(), &Pattern());
    }
    EXPECT_EQ(database_.MP3NamePattern(), u"%ARTIST% - %TITLE%"_s);
    Pattern().setText(u"%TRACKNR%: %TITLE% (%LENGTHF%)"_s);
    EXPECT_EQ(Example(), u"Beispiel: 4- Ein schöner Tag (3-45).mp3"_s);
    Pattern().setText(u"Lied"_s);
    // Without renaming the pattern does not matter, and what cannot be used is not stored.
    Field<QCheckBox>(u"RenameAndMoveMP3s"_s).setChecked(false);
    Click(u"ok"_s);
    EXPECT_EQ(form_->result(), QDialog::Accepted);
    EXPECT_EQ(database_.MP3NamePattern(), u"%ARTIST% - %TITLE%"_s);
}

TEST_F(OptionsFormTest, AMissingRootFolderIsOfferedToBeMade) {
    const QString missing = folder_.filePath(u"neu/musik"_s);
    Open();
    Root().setText(missing);
    Click(u"ok"_s);
    EXPECT_EQ(dialogs_.Questions,
              QStringList{u"Der Ordner "_s + missing + u" ist nicht vorhanden. Soll er angelegt werden?"_s});
    EXPECT_TRUE(dialogs_.Messages.isEmpty());
    EXPECT_EQ(form_->focusWidget(), &Root());
    EXPECT_FALSE(QDir(missing).exists());

    dialogs_.Answers = {0};
    Click(u"ok"_s);
    EXPECT_TRUE(QDir(missing).exists());
    EXPECT_EQ(database_.MP3MoveRootDir(), missing + u'/');

    Open();
    Root().setText(u"musik"_s);
    EXPECT_FALSE(form_->Apply());
    EXPECT_EQ(dialogs_.Messages.last(), u"Der Stammordner musik ist kein vollständiger Pfad."_s);
    Root().setText(folder_.filePath(u"test.conf"_s));
    EXPECT_FALSE(form_->Apply());
    EXPECT_EQ(dialogs_.Messages.last(), folder_.filePath(u"test.conf"_s) + u" ist kein Ordner."_s);
}

TEST_F(OptionsFormTest, GenreFoldersStayInTheRootFolder) {
    Open();
    QTableWidgetItem& cell = *Field<QTableWidget>(u"MP3MoveSubDirs"_s).item(7, 1);
    for (const QString& name : {u""_s, u"../Rap"_s, u"/Rap"_s, u"Rap\\.."_s}) {
        cell.setText(name);
        EXPECT_FALSE(form_->Apply()) << name.toStdString();
    }
    EXPECT_EQ(dialogs_.Messages.first(), u"Der Name des Ordners für das Genre Rap fehlt."_s);
    EXPECT_EQ(dialogs_.Messages.at(1), u"Der Ordner ../Rap für das Genre Rap liegt nicht im Stammordner."_s);
    EXPECT_EQ(Field<QTableWidget>(u"MP3MoveSubDirs"_s).currentRow(), 7);
    cell.setText(u"Hip/Rap"_s);
    EXPECT_TRUE(form_->Apply());
}

TEST_F(OptionsFormTest, CdsAreAddedRenamedAndRemoved) {
    database_.SetCDNames({{u"Alt"_s, 1}, {u"Urlaub"_s, 0xFF00AB12}});
    Open();
    form_->ShowTab(OptionsTab::Cds);
    EXPECT_FALSE(Field<QPushButton>(u"defaults"_s).isEnabled());
    auto& table = Field<QTableWidget>(u"CDNames"_s);
    table.setCurrentCell(0, 0);
    Click(u"removeCd"_s);
    table.item(0, 0)->setText(u"Urlaub 2003"_s);
    Click(u"addCd"_s);
    auto* editor = table.findChild<QLineEdit*>();
    ASSERT_NE(editor, nullptr);
    QTest::keyClicks(editor, u"Neu"_s);
    EXPECT_FALSE(form_->Apply());  // with the cell still open
    EXPECT_EQ(table.item(1, 0)->text(), u"Neu"_s);

    const std::pair<QString, QString> faults[] = {
        {u""_s, u"Die Seriennummer der CD „Neu“ fehlt."_s},
        {u"123456789"_s,
         u"„123456789“ ist keine Seriennummer: erwartet werden bis zu 8 hexadezimale Ziffern."_s},
        {u"xyz"_s, u"„xyz“ ist keine Seriennummer: erwartet werden bis zu 8 hexadezimale Ziffern."_s},
        {u"ff00-ab12"_s, u"Die CDs „Urlaub 2003“ und „Neu“ haben dieselbe Seriennummer."_s}};
    for (const auto& [serial, message] : faults) {
        table.item(1, 1)->setText(serial);
        EXPECT_FALSE(form_->Apply());
        EXPECT_EQ(dialogs_.Messages.last(), message);
    }
    table.item(1, 1)->setText(u"1a2b-3c4d"_s);
    EXPECT_TRUE(form_->Apply());
    ASSERT_EQ(database_.CDNames().size(), 2U);
    EXPECT_EQ(database_.CDNames()[0].Name, u"Neu"_s);
    EXPECT_EQ(database_.CDNames()[0].Serial, 0x1A2B3C4DU);
    EXPECT_EQ(database_.CDNames()[1].Name, u"Urlaub 2003"_s);
}

TEST_F(OptionsFormTest, APlayerNeedsAnEngineAndWinampItsNames) {
    LinkPlayer();
    Open();
    for (const QString& name : {u"UseFMOD"_s, u"UseMCI"_s, u"UseEldoS"_s, u"UseWinamp"_s})
        Field<QCheckBox>(name).setChecked(false);
    EXPECT_FALSE(form_->Apply());
    EXPECT_EQ(Tab(), OptionsTab::Playback);
    EXPECT_EQ(dialogs_.Messages,
              QStringList{u"Mindestens ein System zum Abspielen muss eingeschaltet sein."_s});
    Field<QCheckBox>(u"UseFMOD"_s).setChecked(true);
    Field<QLineEdit>(u"WinAmpClassName"_s).clear();
    EXPECT_FALSE(form_->Apply());
    EXPECT_EQ(dialogs_.Messages.last(), u"Die Fensterklasse von Winamp fehlt."_s);
}

TEST_F(OptionsFormTest, NothingIsChangedDuringARun) {
    Open();
    Field<QCheckBox>(u"FollowFocus"_s).setChecked(false);
    database_.StartProgress(u"Test"_s, false);
    Click(u"ok"_s);
    EXPECT_TRUE(form_->isVisible());
    EXPECT_EQ(dialogs_.Messages.size(), 1);
    database_.EndProgress(false);
    EXPECT_TRUE(database_.FollowFocus());
}

// --- Other things ---

TEST_F(OptionsFormTest, DefaultsAreThoseOfTheShownPageAndNotYetStored) {
    database_.SetUpdateFolders({u"/musik"_s});
    database_.SetMP3NamePattern(u"%TITLE%"_s);
    database_.SetAutoSave(60'000);
    settings_.WriteInteger(u"CrossoverTime"_s, 0);
    Open();
    form_->ShowTab(OptionsTab::Files);
    Click(u"defaults"_s);
    EXPECT_EQ(Pattern().text(), u"%ARTIST% - %TITLE%"_s);
    EXPECT_EQ(Field<QTableWidget>(u"MP3MoveSubDirs"_s).item(19, 1)->text(), u"Classic"_s);
    EXPECT_EQ(Field<QListWidget>(u"UpdateFolders"_s, u"folders"_s).count(), 1);
    EXPECT_EQ(Field<QComboBox>(u"AutoSave"_s).currentIndex(), 2);
    EXPECT_EQ(Field<QSpinBox>(u"CrossoverTime"_s).value(), 0);
    form_->ShowTab(OptionsTab::Playback);
    Click(u"defaults"_s);
    EXPECT_EQ(Field<QSpinBox>(u"CrossoverTime"_s).value(), 10'000);
    EXPECT_FALSE(Field<QCheckBox>(u"UseWinamp"_s).isChecked());
    EXPECT_EQ(database_.MP3NamePattern(), u"%TITLE%"_s);
    EXPECT_TRUE(Field<QPushButton>(u"apply"_s).isEnabled());
}

TEST_F(OptionsFormTest, EveryPlaceholderIsExplained) {
    QStringList explained;
    for (const PlaceholderText& text : PlaceholderTexts())
        explained << QString::fromUtf16(text.Name);
    QStringList known = NamePatternPlaceholders();
    explained.sort();
    known.sort();
    EXPECT_EQ(explained, known);
}

TEST_F(OptionsFormTest, FoldersAreAddedAndRemovedAndNoneLiesBelowAnother) {
    database_.SetUpdateFolders({u"/musik/rock"_s, u"/hörspiele"_s});
    Open();
    form_->ShowTab(OptionsTab::Files);
    auto& list = Field<QListWidget>(u"UpdateFolders"_s, u"folders"_s);
    EXPECT_FALSE(Field<QPushButton>(u"removeFolder"_s).isEnabled());
    for (const QString& folder : {u"/musik/"_s, u"/musik/pop"_s}) {
        dialogs_.Folders = {folder};
        Click(u"addFolder"_s);
    }
    EXPECT_EQ(list.count(), 2);
    list.setFocus();
    list.setCurrentRow(0);
    QTest::keyClick(&list, Qt::Key_Delete);
    EXPECT_TRUE(form_->Apply());
    EXPECT_EQ(database_.UpdateFolders(), QStringList{u"/musik"_s});
    EXPECT_TRUE(database_.Modified());
}

TEST_F(OptionsFormTest, NothingIsClippedAndEveryKeyIsUniqueInAnyFontSize) {
    LinkPlayer();
    WithEveryFontSize([this](int size) {
        Open();
        form_->resize(form_->minimumSizeHint());
        for (int tab = 0; tab < kTabs; ++tab) {
            form_->ShowTab(static_cast<OptionsTab>(tab));
            QApplication::processEvents();
            EXPECT_EQ(ClippedCaptions(*form_), QStringList()) << size << " pt, page " << tab;
            EXPECT_EQ(AmbiguousKeys(*form_), QStringList()) << "page " << tab;
        }
    });
}

}  // namespace
