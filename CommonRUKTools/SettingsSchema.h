#pragma once

#include <QByteArray>
#include <QString>
#include <functional>
#include <optional>
#include <tuple>
#include <type_traits>

class TRWReg;

// Milliseconds: no time that is set anywhere is longer than a day.
inline constexpr int kLongestTime = 24 * 60 * 60 * 1000;

// One setting of the program: its name in the store, its type, its default and the values it may have.
// Components, dialogs, the store and the channel to the player program all read this row, so that a range
// stands in one place.
template <typename T>
struct Setting;

template <>
struct Setting<bool> {
    QStringView Name;
    bool Default = false;
    std::optional<bool> New{};  // what a new installation begins with, where that is not the default

    static constexpr bool Accepts(bool) { return true; }
};

template <>
struct Setting<int> {
    QStringView Name;
    int Default = 0;
    int Least = 0;
    int Most = 0;
    std::optional<int> New{};

    constexpr bool Accepts(int value) const { return value >= Least && value <= Most; }
};

template <>
struct Setting<QString> {
    QStringView Name;
    QStringView Default{};
    std::optional<QStringView> New{};

    static bool Accepts(const QString&) { return true; }
};

template <>
struct Setting<QByteArray> {
    QStringView Name;
    qsizetype Size = 0;  // bytes; 0: of any size

    bool Accepts(const QByteArray& value) const { return Size == 0 || value.size() == Size; }
};

// The stored value; nothing when it is missing, of another type or not accepted.
std::optional<bool> ReadSetting(const TRWReg& store, const Setting<bool>& setting);
std::optional<int> ReadSetting(const TRWReg& store, const Setting<int>& setting);
std::optional<QString> ReadSetting(const TRWReg& store, const Setting<QString>& setting);
std::optional<QByteArray> ReadSetting(const TRWReg& store, const Setting<QByteArray>& setting);

void WriteSetting(TRWReg& store, const Setting<bool>& setting, bool value);
void WriteSetting(TRWReg& store, const Setting<int>& setting, int value);
void WriteSetting(TRWReg& store, const Setting<QString>& setting, const QString& value);
void WriteSetting(TRWReg& store, const Setting<QByteArray>& setting, const QByteArray& value);

constexpr bool DefaultValue(const Setting<bool>& setting) {
    return setting.Default;
}
constexpr int DefaultValue(const Setting<int>& setting) {
    return setting.Default;
}
inline QString DefaultValue(const Setting<QString>& setting) {
    return setting.Default.toString();
}

// What a new installation has.
constexpr bool NewValue(const Setting<bool>& setting) {
    return setting.New.value_or(setting.Default);
}
constexpr int NewValue(const Setting<int>& setting) {
    return setting.New.value_or(setting.Default);
}
inline QString NewValue(const Setting<QString>& setting) {
    return setting.New.value_or(setting.Default).toString();
}

// --- Settings and the properties that hold them ---

// A setting that `Owner` keeps behind a getter and a setter, be they members or functions of the owner.
template <typename T, typename Get, typename Set>
class PropertySetting {
 public:
    constexpr PropertySetting(Setting<T> row, Get get, Set set) : Row(row), get_(get), set_(set) {}

    template <typename Owner>
    T Of(const Owner& owner) const {
        return static_cast<T>(std::invoke(get_, owner));
    }
    template <typename Owner>
    void SetOf(Owner& owner, const T& value) const {
        using Value = std::remove_cvref_t<std::invoke_result_t<Get, const Owner&>>;
        std::invoke(set_, owner, static_cast<Value>(value));
    }

    Setting<T> Row;

 private:
    Get get_;
    Set set_;
};

// A setting that is a member of a plain struct.
template <typename T, typename Owner, typename Value>
class MemberSetting {
 public:
    constexpr MemberSetting(Setting<T> row, Value Owner::*member) : Row(row), member_(member) {}

    T Of(const Owner& owner) const { return static_cast<T>(owner.*member_); }
    void SetOf(Owner& owner, const T& value) const { owner.*member_ = static_cast<Value>(value); }

    Setting<T> Row;

 private:
    Value Owner::*member_;
};

// A table of settings is a tuple of such rows.

template <typename Table, typename Action>
void ForEachSetting(const Table& table, const Action& action) {
    std::apply([&action](const auto&... row) { (action(row), ...); }, table);
}

// What the store does not have stays as it is.
template <typename Table, typename Owner>
void LoadSettingsOf(Owner& owner, const Table& table, const TRWReg& store) {
    ForEachSetting(table, [&](const auto& setting) {
        if (const auto value = ReadSetting(store, setting.Row)) setting.SetOf(owner, *value);
    });
}

template <typename Table, typename Owner>
void SaveSettingsOf(const Owner& owner, const Table& table, TRWReg& store) {
    ForEachSetting(table, [&](const auto& setting) { WriteSetting(store, setting.Row, setting.Of(owner)); });
}

// Stores what a new installation has otherwise.
template <typename Table>
void StoreNewValues(const Table& table, TRWReg& store) {
    ForEachSetting(table, [&store](const auto& setting) {
        if constexpr (requires { setting.Row.New; })
            if (setting.Row.New) WriteSetting(store, setting.Row, NewValue(setting.Row));
    });
}
