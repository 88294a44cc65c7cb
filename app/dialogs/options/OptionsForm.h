#pragma once

#include <QDialog>
#include <functional>
#include <vector>

class OptionsPage;
class QDialogButtonBox;
class QListWidget;
class QPushButton;
class QStackedWidget;
class TMusicDatabase;
class TRWReg;

// The pages of the options, in the order of the list.
enum class OptionsTab { General, Database, Files, Rules, Playback, Cds, Conversion, RemoteControl, Internet };

// The options of the program: settings of the database, and in the settings store those of the components
// that work with it.
class TOptionsForm : public QDialog {
 public:
    // Both outlive the dialog.
    TOptionsForm(TMusicDatabase& database, TRWReg& settings, QWidget* parent = nullptr);
    ~TOptionsForm() override;

    void ShowTab(OptionsTab tab);
    // Takes over what is shown. False when something is wrong with it; the user has been told, and the dialog
    // shows the field. Throws EStreamError when the settings cannot be stored.
    bool Apply();

    // Told after every "OK" and "Übernehmen", when database, store and components have the new values.
    std::function<void()> OnApplied;

    void accept() override;

 private:
    void AddPage(OptionsPage* page);
    void LinkTwins();
    void SetUpButtons();
    void SetUpLayout();
    void SetUpSize();
    void Load();
    void Store();
    void LoadDefaults();
    bool Check();
    void CommitOpenEditor();
    void SetChanged(bool changed);
    OptionsPage& CurrentPage() const;

    TMusicDatabase& database_;
    TRWReg& settings_;
    std::vector<OptionsPage*> pages_;
    QListWidget* list_;
    QStackedWidget* stack_;
    QDialogButtonBox* buttons_;
    QPushButton* apply_ = nullptr;
    QPushButton* defaults_ = nullptr;
};
