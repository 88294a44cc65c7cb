#pragma once

#include <vector>

#include "app/dialogs/options/OptionsPage.h"

class QPushButton;
class QTableWidget;
struct CdName;

// "CDs": the names under which the media of the catalogue are shown.
class CdsPage : public OptionsPage {
 public:
    CdsPage();

    void Load(const TMusicDatabase& database, const TRWReg& settings) override;
    std::optional<OptionsFault> Check() override;
    void Apply(TMusicDatabase& database, TRWReg& settings) override;
    // The list is the user's own.
    void LoadDefaults() override {}
    bool HasDefaults() const override { return false; }

 private:
    void AddButtons(QFormLayout& group);
    void AddCd(const CdName& cd);
    void Add();
    void Rename();
    void Remove();
    void EnableButtons();
    // What is wrong with a row, and which of its cells; nothing when it is complete.
    std::optional<QString> FaultOfRow(int row, int& column) const;

    QTableWidget* table_;
    QPushButton* rename_ = nullptr;
    QPushButton* remove_ = nullptr;
};
