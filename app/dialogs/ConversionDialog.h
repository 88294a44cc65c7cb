#pragma once

#include <QDialog>

#include "MusicManagment/conversion/ConvertSongs.h"

class Mp3Page;
class QComboBox;
class QGroupBox;
class QRadioButton;
class QStackedWidget;
class RootFolderField;
class WavPage;
class WmaPage;
class WrappedLabel;

// What is to be converted, into what, and where it goes.
struct ConversionChoice {
    BatchRange Range = BatchRange::Marked;  // marked or all
    ConversionOrder Order{};
    EncoderSettings Settings{};
};

// Asks for it. How many songs are marked and there are is only shown.
class ConversionDialog : public QDialog {
 public:
    ConversionDialog(const ConversionChoice& choice, std::size_t marked, std::size_t all,
                     QWidget* parent = nullptr);

    ConversionChoice Choice() const;
    // A folder that cannot be one keeps the dialog open, with a line that says why.
    void accept() override;

 private:
    void AddSongs(std::size_t marked, std::size_t all, BatchRange range);
    QGroupBox* MakePages();
    QGroupBox* MakePlaces();
    void SetUpLayout();
    void ShowFormat();
    void EnableFolder();
    MusicFormat Format() const;
    ConversionPlace Place() const;

    const ConversionChoice given_;
    QComboBox* songs_;
    QComboBox* format_;
    QGroupBox* box_ = nullptr;
    QStackedWidget* pages_ = nullptr;
    Mp3Page* mp3_;
    WavPage* wav_;
    WmaPage* wma_;
    QRadioButton* beside_ = nullptr;
    QRadioButton* inFolder_ = nullptr;
    QRadioButton* inPlace_ = nullptr;
    RootFolderField* folder_;
    WrappedLabel* note_ = nullptr;
};
