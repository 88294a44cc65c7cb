#include "app/SettingsCommands.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QCheckBox>
#include <QTemporaryDir>
#include <QTest>
#include <QTimer>

#include "CommonRUKTools/RWReg.h"
#include "MusicManagment/database/commands/DatabaseSettings.h"
#include "MusicManagment/playback/PlayerSettings.h"
#include "MusicManagment/playlist/PlayListSettings.h"
#include "app/MainWindow.h"
#include "app/dialogs/options/OptionsForm.h"
#include "app/dialogs/wizard/WizardForm.h"
#include "app/views/WindowSettings.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/app/Menus.h"

using namespace Qt::StringLiterals;

namespace {

const QString kKey = u"\\Software\\RUK\\Tunestead3"_s;

enum class Pick { Least, Default, Most };

bool ValueAt(const Setting<bool>& setting, Pick pick) {
    return pick == Pick::Default ? setting.Default : pick == Pick::Most;
}
int ValueAt(const Setting<int>& setting, Pick pick) {
    if (pick == Pick::Default) return setting.Default;
    return pick == Pick::Least ? setting.Least : setting.Most;
}
QString ValueAt(const Setting<QString>& setting, Pick pick) {
    if (pick == Pick::Default && !setting.Default.isEmpty()) return setting.Default.toString();
    return QString(u"/ö"_s).repeated(pick == Pick::Most ? 500 : 1) + u'/';
}

// Every setting that has a value of its own.
template <typename Action>
void ForEveryRow(const Action& action) {
    const auto ofRow = [&action](const auto& setting) { action(setting.Row); };
    ForEachSetting(DatabaseSettings::kAll, ofRow);
    ForEachSetting(PlayListSettings::kAll, ofRow);
    ForEachSetting(PlayerSettings::kEngines, ofRow);
    ForEachSetting(PlayerSettings::kOwn, ofRow);
    action(DatabaseSettings::kLastMusicFormat.Row);
    action(DatabaseSettings::kRCEnabled);
    action(PlayerSettings::kCrossover);
    action(WindowSettings::kOVType);
    action(WindowSettings::kVolume);
    action(WindowSettings::kSpectrumStyle);
    action(WindowSettings::kLinkPath);
    action(WindowSettings::kPlayOnlyThisSong);
}

// A way to a player program that is not there.
class AbsentPlayer : public ExternalPlayer {
 public:
    std::optional<qint64> Find() override { return std::nullopt; }
    bool Start(const QString&, const QString&) override { return false; }
    void Wait(int) override {}
    qint64 SendCommand(ExternalCommand, qint64) override { return 0; }
    qint64 SendText(ExternalCommand, const QString&) override { return 0; }
    bool RegisterFeedback() override { return false; }
    std::optional<qint64> CreateFeedback(FeedbackReceiver&) override { return std::nullopt; }
};

// The main window with the commands as a user reaches them.
class SettingsCommandsTest : public testing::Test {
 protected:
    void Start(bool offerWizard) {
        window_.reset();
        window_ = std::make_unique<TTunesteadMainWnd>(
            MainWindowOptions{.Files = {folder_.path()},
                              .SettingsFile = SettingsFile(),
                              .OfferWizard = offerWizard,
                              .MakeExternalPlayer = [] { return std::make_unique<AbsentPlayer>(); }});
        window_->show();
    }
    static void Work() {
        for (int i = 0; i < 5; ++i)
            QApplication::processEvents();
    }
    // What is done with the dialog that opens next; counts how many there were.
    template <typename Dialog>
    void WithNext(std::function<void(Dialog&)> action) {
        QTimer::singleShot(0, window_.get(), [this, action] {
            auto* dialog = qobject_cast<Dialog*>(QApplication::activeModalWidget());
            if (dialog == nullptr) return;
            ++dialogCount_;
            action(*dialog);
        });
    }
    QString SettingsFile() const { return folder_.filePath(u"settings.ini"_s); }

    QTemporaryDir folder_;
    ScriptedDialogs dialogs_;
    int dialogCount_ = 0;
    std::unique_ptr<TTunesteadMainWnd> window_;
};

TEST_F(SettingsCommandsTest, TheWizardIsOfferedAtTheFirstStartOnly) {
    for (const int expected : {1, 1}) {
        Start(true);
        WithNext<QWizard>([](QWizard& wizard) { wizard.reject(); });
        Work();
        EXPECT_EQ(dialogCount_, expected);
    }
    EXPECT_TRUE(window_->Database().RenameAndMoveMP3s());
}

TEST_F(SettingsCommandsTest, WhatTheWizardSetsIsStoredAtOnce) {
    Start(true);
    WithNext<QWizard>([](QWizard& wizard) {
        while (wizard.nextId() >= 0)
            wizard.next();
        wizard.findChild<QCheckBox*>(u"scanNow"_s)->setChecked(false);
        wizard.accept();
    });
    Work();
    EXPECT_EQ(dialogCount_, 1);
    EXPECT_FALSE(window_->Database().RenameAndMoveMP3s());
    const TRWReg stored(kKey, SettingsFile());
    EXPECT_EQ(stored.ReadBool(u"RenameAndMoveMP3s"_s), false);
}

TEST_F(SettingsCommandsTest, OkWithoutATouchKeepsEveryAcceptedValue) {
    for (const Pick pick : {Pick::Least, Pick::Default, Pick::Most}) {
        {
            TRWReg settings(kKey, SettingsFile());
            ForEveryRow([&](const auto& row) { WriteSetting(settings, row, ValueAt(row, pick)); });
        }
        Start(false);
        Work();
        WithNext<QDialog>([](QDialog& form) { form.accept(); });
        MenuItem(*window_, u"Einstellungen..."_s)->trigger();
        EXPECT_EQ(dialogs_.Messages + dialogs_.Questions, QStringList());
        window_->close();
        const TRWReg settings(kKey, SettingsFile());
        ForEveryRow([&](const auto& row) {
            EXPECT_EQ(ReadSetting(settings, row), ValueAt(row, pick)) << row.Name.toString().toStdString();
        });
    }
    EXPECT_EQ(dialogCount_, 3);
}

TEST_F(SettingsCommandsTest, ANewInstallationBeginsWithWhatAUserOfTodayWants) {
    Start(false);
    window_->close();
    {
        TRWReg settings(kKey, SettingsFile());
        EXPECT_EQ(settings.ReadInteger(u"AutoSave"_s), -1);
        for (const QString& name : {u"UseEldoS"_s, u"UseWinamp"_s})
            EXPECT_EQ(settings.ReadBool(name), false) << name.toStdString();
        EXPECT_EQ(settings.ReadBool(u"ModernTags"_s), true);
        settings.WriteBool(u"UseEldoS"_s, true);
        settings.Delete(u"UseWinamp"_s);
    }
    // An existing one keeps what it has, and what it does not have is what it was.
    Start(false);
    window_->close();
    const TRWReg settings(kKey, SettingsFile());
    for (const QString& name : {u"UseEldoS"_s, u"UseWinamp"_s})
        EXPECT_EQ(settings.ReadBool(name), true) << name.toStdString();
}

TEST_F(SettingsCommandsTest, TheOptionsChangeTheWindowsMenuToo) {
    Start(false);
    Work();
    QAction* options = MenuItem(*window_, u"Einstellungen..."_s);
    ASSERT_NE(options, nullptr);
    EXPECT_EQ(options->shortcut(), QKeySequence(u"Ctrl+,"_s));
    QAction* backwards = MenuItem(*window_, u"Reihenfolge umkehren"_s);
    ASSERT_FALSE(backwards->isChecked());
    WithNext<QDialog>([](QDialog& form) {
        form.findChild<QCheckBox*>(u"SortBackwards"_s)->setChecked(true);
        form.accept();
    });
    options->trigger();
    EXPECT_EQ(dialogCount_, 1);
    EXPECT_TRUE(window_->Database().SortBackwards());
    EXPECT_TRUE(backwards->isChecked());
}

}  // namespace
