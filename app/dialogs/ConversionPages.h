#pragma once

#include <QWidget>

#include "MusicManagment/conversion/EncoderSettings.h"

class QCheckBox;
class QComboBox;
class QFormLayout;
class QSpinBox;

// The settings of each format that songs are converted into, as pages of a dialog.

class Mp3Page : public QWidget {
 public:
    explicit Mp3Page(const Mp3Settings& settings, QWidget* parent = nullptr);
    Mp3Settings Settings() const;

 private:
    void EnableFields();

    QComboBox* method_;
    QComboBox* quality_;
    QComboBox* bitRate_;
    QComboBox* sides_;
    QComboBox* rate_;
    QSpinBox* effort_;
};

class WavPage : public QWidget {
 public:
    explicit WavPage(const WavSettings& settings, QWidget* parent = nullptr);
    WavSettings Settings() const;

 private:
    QComboBox* bits_;
    QComboBox* sides_;
    QComboBox* rate_;
    QCheckBox* dither_;
};

class WmaPage : public QWidget {
 public:
    explicit WmaPage(const WmaSettings& settings, QWidget* parent = nullptr);
    WmaSettings Settings() const;

 private:
    QComboBox* bitRate_;
    QComboBox* rate_;
    QSpinBox* minutes_;
};
