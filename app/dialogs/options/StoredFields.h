#pragma once

#include <QString>
#include <functional>
#include <vector>

class QCheckBox;
class QComboBox;
class QLineEdit;
class QSpinBox;
class TRWReg;

// Fields that show values of the settings store. A value that is missing, of another type or out of the
// field's range shows the default.
class StoredFields {
 public:
    void BindBool(QCheckBox* field, const QString& name, bool standard);
    void BindInteger(QSpinBox* field, const QString& name, int standard);
    // The value is the number of the chosen row.
    void BindChoice(QComboBox* field, const QString& name, int standard);
    void BindText(QLineEdit* field, const QString& name, const QString& standard);

    void Load(const TRWReg& settings) const;
    void Store(TRWReg& settings) const;

 private:
    struct Binding {
        std::function<void(const TRWReg&)> Load;
        std::function<void(TRWReg&)> Store;
    };
    std::vector<Binding> bindings_;
};
