#include "app/dialogs/options/SettingFields.h"

#include <QCheckBox>
#include <QComboBox>
#include <QLineEdit>
#include <QSpinBox>

FieldValue<bool> ValueOf(QCheckBox* field, const Setting<bool>&) {
    return {[field] { return field->isChecked(); }, [field](bool value) { field->setChecked(value); }};
}

FieldValue<int> ValueOf(QSpinBox* field, const Setting<int>& setting) {
    field->setRange(setting.Least, setting.Most);
    return {[field] { return field->value(); }, [field](int value) { field->setValue(value); }};
}

FieldValue<int> ValueOf(QComboBox* field, const Setting<int>& setting) {
    const int least = setting.Least;
    return {[=] { return field->currentIndex() + least; },
            [=](int value) { field->setCurrentIndex(value - least); }};
}

FieldValue<QString> ValueOf(QLineEdit* field, const Setting<QString>&) {
    return {[field] { return field->text(); },
            [field](const QString& value) {
                field->setText(value);
                field->setCursorPosition(0);
            }};
}

void SettingFields::Load(const TMusicDatabase& database, const TRWReg& store) const {
    for (const Binding& binding : bindings_)
        binding.Load(database, store);
}

void SettingFields::ShowNewValues() const {
    for (const Binding& binding : bindings_)
        binding.ShowNewValue();
}

void SettingFields::Store(TMusicDatabase& database, TRWReg& store) const {
    for (const Binding& binding : bindings_)
        binding.Store(database, store);
}
