#pragma once

#include <QDockWidget>

#include "MusicManagment/database/commands/Settings.h"

class QActionGroup;
class TDSPDraw;

// The tool window of the spectrum. How it is drawn is chosen in its context menu.
class TSpectrumForm : public QDockWidget, public SettingsClient {
 public:
    explicit TSpectrumForm(QWidget* parent = nullptr);

    TDSPDraw& Draw() { return *draw_; }

    void LoadSettings(const TRWReg& settings) override;
    void SaveSettings(TRWReg& settings) const override;

 private:
    void AddStyles();
    void ShowStyle();

    TDSPDraw* draw_;
    QActionGroup* styles_;
};
