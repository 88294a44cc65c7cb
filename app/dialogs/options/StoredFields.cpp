#include "app/dialogs/options/StoredFields.h"

#include <QCheckBox>
#include <QComboBox>
#include <QLineEdit>
#include <QSpinBox>

#include "CommonRUKTools/RWReg.h"

void StoredFields::BindBool(QCheckBox* field, const QString& name, bool standard) {
    bindings_.push_back(
        {[=](const TRWReg& settings) { field->setChecked(settings.ReadBool(name).value_or(standard)); },
         [=](TRWReg& settings) { settings.WriteBool(name, field->isChecked()); }});
}

void StoredFields::BindInteger(QSpinBox* field, const QString& name, int standard) {
    const auto load = [=](const TRWReg& settings) {
        const int value = settings.ReadInteger(name).value_or(standard);
        const bool inRange = value >= field->minimum() && value <= field->maximum();
        field->setValue(inRange ? value : standard);
    };
    bindings_.push_back({load, [=](TRWReg& settings) { settings.WriteInteger(name, field->value()); }});
}

void StoredFields::BindChoice(QComboBox* field, const QString& name, int standard) {
    const auto load = [=](const TRWReg& settings) {
        const int value = settings.ReadInteger(name).value_or(standard);
        field->setCurrentIndex(value >= 0 && value < field->count() ? value : standard);
    };
    bindings_.push_back(
        {load, [=](TRWReg& settings) { settings.WriteInteger(name, field->currentIndex()); }});
}

void StoredFields::BindText(QLineEdit* field, const QString& name, const QString& standard) {
    bindings_.push_back({[=](const TRWReg& settings) {
                             field->setText(settings.ReadString(name).value_or(standard));
                             field->setCursorPosition(0);
                         },
                         [=](TRWReg& settings) { settings.WriteString(name, field->text()); }});
}

void StoredFields::Load(const TRWReg& settings) const {
    for (const Binding& binding : bindings_)
        binding.Load(settings);
}

void StoredFields::Store(TRWReg& settings) const {
    for (const Binding& binding : bindings_)
        binding.Store(settings);
}
