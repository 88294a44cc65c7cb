#include "app/SettingsCommands.h"

#include <gtest/gtest.h>

#include <QAction>
#include <QApplication>
#include <QCheckBox>
#include <QMenu>
#include <QMenuBar>
#include <QTemporaryDir>
#include <QTest>
#include <QTimer>

#include "CommonRUKTools/RWReg.h"
#include "app/MainWindow.h"
#include "app/dialogs/options/OptionsForm.h"
#include "app/dialogs/wizard/WizardForm.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"

using namespace Qt::StringLiterals;

namespace {

// The main window with the commands as a user reaches them.
class SettingsCommandsTest : public testing::Test {
 protected:
    void Start(bool offerWizard) {
        window_.reset();
        window_ = std::make_unique<TTunesteadMainWnd>(MainWindowOptions{
            .Files = {folder_.path()}, .SettingsFile = SettingsFile(), .OfferWizard = offerWizard});
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
    QAction* ExtrasItem(const QString& caption) {
        for (QAction* menu : window_->menuBar()->actions())
            for (QAction* action : menu->menu()->actions())
                if (QString(action->text()).remove(u'&') == caption) return action;
        return nullptr;
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
    const TRWReg stored(u"\\Software\\RUK\\Tunestead3"_s, SettingsFile());
    EXPECT_EQ(stored.ReadBool(u"RenameAndMoveMP3s"_s), false);
}

TEST_F(SettingsCommandsTest, TheOptionsChangeTheWindowsMenuToo) {
    Start(false);
    Work();
    QAction* options = ExtrasItem(u"Einstellungen..."_s);
    ASSERT_NE(options, nullptr);
    EXPECT_EQ(options->shortcut(), QKeySequence(u"Ctrl+,"_s));
    QAction* backwards = ExtrasItem(u"Reihenfolge umkehren"_s);
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

TEST_F(SettingsCommandsTest, TheItemsRestDuringARun) {
    Start(false);
    Work();
    window_->Database().StartProgress(u"Test"_s, false);
    EXPECT_FALSE(ExtrasItem(u"Einstellungen..."_s)->isEnabled());
    window_->Database().EndProgress(false);
    EXPECT_TRUE(ExtrasItem(u"Einrichtungsassistent..."_s)->isEnabled());
}

}  // namespace
