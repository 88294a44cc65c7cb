#include "CommonRUKTools/SettingsSchema.h"

#include "CommonRUKTools/RWReg.h"

namespace {

template <typename T>
std::optional<T> Accepted(std::optional<T> value, const Setting<T>& setting) {
    return value && setting.Accepts(*value) ? std::move(value) : std::nullopt;
}

}  // namespace

std::optional<bool> ReadSetting(const TRWReg& store, const Setting<bool>& setting) {
    return store.ReadBool(setting.Name.toString());
}

std::optional<int> ReadSetting(const TRWReg& store, const Setting<int>& setting) {
    return Accepted(store.ReadInteger(setting.Name.toString()), setting);
}

std::optional<QString> ReadSetting(const TRWReg& store, const Setting<QString>& setting) {
    return store.ReadString(setting.Name.toString());
}

std::optional<QByteArray> ReadSetting(const TRWReg& store, const Setting<QByteArray>& setting) {
    return Accepted(store.ReadBinary(setting.Name.toString()), setting);
}

void WriteSetting(TRWReg& store, const Setting<bool>& setting, bool value) {
    store.WriteBool(setting.Name.toString(), value);
}

void WriteSetting(TRWReg& store, const Setting<int>& setting, int value) {
    store.WriteInteger(setting.Name.toString(), value);
}

void WriteSetting(TRWReg& store, const Setting<QString>& setting, const QString& value) {
    store.WriteString(setting.Name.toString(), value);
}

void WriteSetting(TRWReg& store, const Setting<QByteArray>& setting, const QByteArray& value) {
    store.WriteBinary(setting.Name.toString(), value);
}
