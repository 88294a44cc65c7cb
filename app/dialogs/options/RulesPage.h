#pragma once

#include <vector>

#include "app/dialogs/options/OptionsPage.h"

class QRadioButton;

// "Regeln": the pairs of classic and modern rules, all at once or one by one.
class RulesPage : public OptionsPage {
 public:
    // Rules of components that `database` is not linked to are shown greyed out.
    explicit RulesPage(const TMusicDatabase& database);

    void Load(const TMusicDatabase& database, const TRWReg& settings) override;
    void LoadDefaults() override;

 protected:
    void showEvent(QShowEvent* event) override;

 private:
    void AddChoice();
    QCheckBox* AddRule(QFormLayout& group, QStringView name, const QString& caption,
                       const QString& explanation);
    void SetAll(bool modern);
    void ShowChoice();
    void EnableRules();

    QRadioButton* modern_;
    QRadioButton* classic_;
    QRadioButton* single_;
    std::vector<QCheckBox*> rules_;
};
