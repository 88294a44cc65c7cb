#include "app/dialogs/ConversionDialog.h"

#include <gtest/gtest.h>

#include <QCheckBox>
#include <QComboBox>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QStackedWidget>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

TEST(ConversionDialog, WhatIsShownComesBackAndWhatIsChosenChangesIt) {
    ConversionChoice choice;
    choice.Order = {.Format = MusicFormat::Wav, .Place = ConversionPlace::InPlace, .Folder = u"/alt"_s};
    choice.Settings.Mp3 = {.Bits = Mp3Settings::Method::Average,
                           .Quality = 7,
                           .BitRate = 177,  // none of those that are offered
                           .Effort = 5,
                           .Sides = Mp3Settings::Channels::Mono,
                           .Rate = 32000};
    choice.Settings.Wav = {
        .Bits = 24, .Sides = WavSettings::Channels::Stereo, .Rate = 96000, .Dither = false};
    choice.Settings.Wma = {.BitRate = 96, .Rate = 22050, .TimeLimit = std::chrono::minutes(3)};
    choice.Settings.Script = u"/opt/enc"_s;
    ConversionDialog dialog(choice, 2, 9);
    EXPECT_EQ(dialog.Choice().Settings, choice.Settings);
    EXPECT_EQ(dialog.Choice().Range, BatchRange::Marked);
    EXPECT_EQ(dialog.Choice().Order.Place, ConversionPlace::InPlace);

    const auto page = [&] { return dialog.findChild<QStackedWidget*>()->currentWidget(); };
    EXPECT_NE(page()->findChild<QCheckBox*>(u"dither"_s), nullptr);
    dialog.findChild<QComboBox*>(u"format"_s)->setCurrentText(u"MP3"_s);
    auto* quality = page()->findChild<QComboBox*>(u"quality"_s);
    ASSERT_NE(quality, nullptr);
    EXPECT_FALSE(quality->isEnabled());
    page()->findChild<QComboBox*>(u"method"_s)->setCurrentIndex(0);
    EXPECT_TRUE(quality->isEnabled());
    EXPECT_FALSE(page()->findChild<QComboBox*>(u"bitRate"_s)->isEnabled());
    dialog.findChild<QComboBox*>(u"songs"_s)->setCurrentIndex(1);

    // A folder that is none keeps it open.
    dialog.findChild<QRadioButton*>(u"inFolder"_s)->setChecked(true);
    auto* folder = dialog.findChild<QLineEdit*>(u"folder"_s);
    for (const QString& bad : {u""_s, u"irgendwo"_s}) {
        folder->setText(bad);
        dialog.accept();
        EXPECT_EQ(dialog.result(), QDialog::Rejected);
        EXPECT_TRUE(
            dialog.findChild<QLabel*>(u"note"_s)->text().startsWith(bad.isEmpty() ? u"Wählen"_s : bad));
    }
    folder->setText(u"/neu"_s);
    dialog.accept();
    EXPECT_EQ(dialog.result(), QDialog::Accepted);
    const ConversionChoice chosen = dialog.Choice();
    EXPECT_EQ(chosen.Range, BatchRange::All);
    EXPECT_EQ(chosen.Order.Format, MusicFormat::Mp3);
    EXPECT_EQ(chosen.Order.Place, ConversionPlace::Folder);
    EXPECT_EQ(chosen.Order.Folder, u"/neu"_s);
    EXPECT_EQ(chosen.Settings.Mp3.Bits, Mp3Settings::Method::Variable);
    EXPECT_EQ(chosen.Settings.Wav, choice.Settings.Wav);
}
