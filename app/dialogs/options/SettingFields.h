#pragma once

#include <functional>
#include <memory>
#include <vector>

#include "CommonRUKTools/SettingsSchema.h"

class QCheckBox;
class QComboBox;
class QLineEdit;
class QSpinBox;
class TMusicDatabase;
class TRWReg;

// What the user has chosen in a field, and how a value is shown there.
template <typename T>
struct FieldValue {
    std::function<T()> Get;
    std::function<void(const T&)> Show;
};

// Each gives the field the range of its setting; the rows of a choice are the values in their order.
FieldValue<bool> ValueOf(QCheckBox* field, const Setting<bool>& setting);
FieldValue<int> ValueOf(QSpinBox* field, const Setting<int>& setting);
FieldValue<int> ValueOf(QComboBox* field, const Setting<int>& setting);
FieldValue<QString> ValueOf(QLineEdit* field, const Setting<QString>& setting);

// Fields of a page that show settings. What nobody has touched is not written, so that a field which cannot
// show a value as it is leaves it as it is.
class SettingFields {
 public:
    // A setting that a component finds in the store. A value that the store does not have shows the default.
    template <typename Field, typename T>
    void Bind(Field* field, const Setting<T>& setting) {
        Add<T>(
            ValueOf(field, setting), setting,
            [setting](const TMusicDatabase&, const TRWReg& store) {
                return ReadSetting(store, setting).value_or(DefaultValue(setting));
            },
            [setting](TMusicDatabase&, TRWReg& store, const T& value) {
                WriteSetting(store, setting, value);
            });
    }
    // A property of the database.
    template <typename Field, typename T, typename Get, typename Set>
    void Bind(Field* field, const PropertySetting<T, Get, Set>& setting) {
        Bind(ValueOf(field, setting.Row), setting);
    }
    template <typename T, typename Get, typename Set>
    void Bind(const FieldValue<T>& field, const PropertySetting<T, Get, Set>& setting) {
        Add<T>(
            field, setting.Row,
            [setting](const TMusicDatabase& database, const TRWReg&) { return setting.Of(database); },
            [setting](TMusicDatabase& database, TRWReg&, const T& value) { setting.SetOf(database, value); });
    }

    void Load(const TMusicDatabase& database, const TRWReg& store) const;
    // Shows what a new installation has; it counts as touched where it differs.
    void ShowNewValues() const;
    void Store(TMusicDatabase& database, TRWReg& store) const;

 private:
    struct Binding {
        std::function<void(const TMusicDatabase&, const TRWReg&)> Load;
        std::function<void()> ShowNewValue;
        std::function<void(TMusicDatabase&, TRWReg&)> Store;
    };

    template <typename T>
    void Add(const FieldValue<T>& field, const Setting<T>& setting,
             const std::function<T(const TMusicDatabase&, const TRWReg&)>& read,
             const std::function<void(TMusicDatabase&, TRWReg&, const T&)>& write) {
        const auto shown = std::make_shared<T>();
        const auto load = [=](const TMusicDatabase& database, const TRWReg& store) {
            field.Show(read(database, store));
            *shown = field.Get();
        };
        const auto save = [=](TMusicDatabase& database, TRWReg& store) {
            const T value = field.Get();
            if (value == *shown) return;
            write(database, store, value);
            *shown = value;
        };
        bindings_.push_back({load, [=] { field.Show(NewValue(setting)); }, save});
    }

    std::vector<Binding> bindings_;
};
