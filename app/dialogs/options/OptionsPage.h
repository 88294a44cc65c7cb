#pragma once

#include <QIcon>
#include <QString>
#include <QWidget>
#include <optional>

#include "app/dialogs/options/SettingFields.h"

class QFormLayout;
class QVBoxLayout;

// Why the values of a page cannot be taken over.
struct OptionsFault {
    QString Text;  // for the user; empty when the user has been told already
    QWidget* Field = nullptr;
};

// One page of the options: shows settings, checks what the user made of them, and stores them. Pages write to
// the database or to the settings store; a component that is not there yet finds its values in the store.
class OptionsPage : public QWidget {
 public:
    OptionsPage(const QString& caption, const QIcon& icon);

    const QString& Caption() const { return caption_; }
    const QIcon& Icon() const { return icon_; }

    // Shows the values in force.
    virtual void Load(const TMusicDatabase& database, const TRWReg& settings) {
        fields_.Load(database, settings);
    }
    // May ask the user. Nothing when everything can be applied.
    virtual std::optional<OptionsFault> Check() { return std::nullopt; }
    // Takes over what the user has touched.
    virtual void Apply(TMusicDatabase& database, TRWReg& settings) { fields_.Store(database, settings); }
    // Shows the values of a new installation; nothing is stored. Lists that the user has put together are no
    // values and stay.
    virtual void LoadDefaults() { fields_.ShowNewValues(); }
    virtual bool HasDefaults() const { return true; }

 protected:
    // A box with a title and rows; it is the `parentWidget()` of the layout.
    QFormLayout& AddGroup(const QString& title);
    // Rows of a group, in the order of the Tab key. `name` is the widget's object name, a "&" in `caption`
    // marks the key.
    QCheckBox* AddCheck(QFormLayout& group, const QString& name, const QString& caption,
                        const QString& toolTip = QString());
    template <typename Field>
    Field* AddField(QFormLayout& group, const QString& name, const QString& caption, Field* field,
                    const QString& toolTip = QString()) {
        AddRow(group, name, caption, *field, toolTip);
        return field;
    }
    // A field that is as wide as the box, with the label above it.
    template <typename Field>
    Field* AddWide(QFormLayout& group, const QString& name, const QString& caption, Field* field,
                   const QString& toolTip = QString()) {
        AddWideRow(group, name, caption, *field, toolTip);
        return field;
    }
    static void AddText(QFormLayout& group, const QString& text);
    // Explains the choice in the row above.
    static void AddExplanation(QFormLayout& group, const QString& text);
    // Greys out a group whose options do nothing yet, and says why.
    static void SetAvailable(QFormLayout& group, bool available, const QString& reason);

    SettingFields fields_;

 private:
    static void AddRow(QFormLayout& group, const QString& name, const QString& caption, QWidget& field,
                       const QString& toolTip);
    static void AddWideRow(QFormLayout& group, const QString& name, const QString& caption, QWidget& field,
                           const QString& toolTip);

    QString caption_;
    QIcon icon_;
    QVBoxLayout* groups_;
};
