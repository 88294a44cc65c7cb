#include "CommonRUKTools/RWReg.h"

#include <QDir>
#include <QSettings>
#include <QStandardPaths>

#include "CommonRUKTools/Errors.h"

using namespace Qt::StringLiterals;

namespace {

// The type stands before each value: QSettings alone gives back every value of a text file as a text.
const QString kInteger = u"int:"_s;
const QString kBool = u"bool:"_s;
const QString kString = u"text:"_s;
const QString kBinary = u"hex:"_s;

QString GroupOf(const QString& key) {
    QString group = key;
    group.replace(u'\\', u'/');
    while (group.startsWith(u'/'))
        group.remove(0, 1);
    return group;
}

}  // namespace

TRWReg::TRWReg(const QString& key, const QString& file)
    : settings_(std::make_unique<QSettings>(file, QSettings::IniFormat)) {
    settings_->beginGroup(GroupOf(key));
}

TRWReg::~TRWReg() = default;

QString TRWReg::DefaultFile() {
    const QDir folder(QStandardPaths::writableLocation(QStandardPaths::GenericConfigLocation));
    return folder.filePath(u"tunestead/tunestead.conf"_s);
}

bool TRWReg::IsEmpty() const {
    return settings_->allKeys().isEmpty();
}

bool TRWReg::Exists(const QString& name) const {
    return settings_->contains(name);
}

std::optional<int> TRWReg::ReadInteger(const QString& name) const {
    const auto text = Read(kInteger, name);
    bool isNumber = false;
    const int value = text ? text->toInt(&isNumber) : 0;
    return isNumber ? std::optional(value) : std::nullopt;
}

std::optional<bool> TRWReg::ReadBool(const QString& name) const {
    const auto text = Read(kBool, name);
    if (text == u"true"_s) return true;
    if (text == u"false"_s) return false;
    return std::nullopt;
}

std::optional<QString> TRWReg::ReadString(const QString& name) const {
    return Read(kString, name);
}

std::optional<QByteArray> TRWReg::ReadBinary(const QString& name) const {
    const auto text = Read(kBinary, name);
    if (!text) return std::nullopt;
    const QByteArray digits = text->toLatin1();
    const QByteArray bytes = QByteArray::fromHex(digits);
    return bytes.toHex() == digits.toLower() ? std::optional(bytes) : std::nullopt;
}

void TRWReg::WriteInteger(const QString& name, int value) {
    Write(kInteger, name, QString::number(value));
}

void TRWReg::WriteBool(const QString& name, bool value) {
    Write(kBool, name, value ? u"true"_s : u"false"_s);
}

void TRWReg::WriteString(const QString& name, const QString& value) {
    Write(kString, name, value);
}

void TRWReg::WriteBinary(const QString& name, const QByteArray& value) {
    Write(kBinary, name, QString::fromLatin1(value.toHex()));
}

void TRWReg::Delete(const QString& name) {
    settings_->remove(name);
}

void TRWReg::DeleteNumbered(const QString& name, int first) {
    for (int i = first; Exists(name + QString::number(i)); ++i)
        Delete(name + QString::number(i));
}

void TRWReg::Flush() {
    settings_->sync();
    if (settings_->status() != QSettings::NoError)
        throw EStreamError(u"Kann die Einstellungen nicht speichern: "_s + settings_->fileName());
}

std::optional<QString> TRWReg::Read(const QString& type, const QString& name) const {
    const QString stored = settings_->value(name).toString();
    if (!stored.startsWith(type)) return std::nullopt;
    return stored.mid(type.size());
}

void TRWReg::Write(const QString& type, const QString& name, const QString& value) {
    const QString stored = type + value;
    if (settings_->value(name) != stored) settings_->setValue(name, stored);
}
