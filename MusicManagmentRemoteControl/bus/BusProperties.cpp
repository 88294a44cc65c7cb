#include "MusicManagmentRemoteControl/bus/BusProperties.h"

#include <QDBusVariant>

#include "CommonRUKTools/CommandRunner.h"
#include "MusicManagmentRemoteControl/bus/BusDoor.h"

using namespace Qt::StringLiterals;

QString PropertiesInterface() {
    return u"org.freedesktop.DBus.Properties"_s;
}

bool AnswerProperties(const BusProperties& properties, const QDBusMessage& call, const QDBusConnection& bus) {
    const QVariantList arguments = call.arguments();
    const QVariantMap values = properties.Of(arguments.value(0).toString());
    const QString name = arguments.value(1).toString();
    if (call.member() == u"GetAll"_s) return Reply(bus, call, {values}), true;
    const bool isGet = call.member() == u"Get"_s;
    if (!isGet && call.member() != u"Set"_s) return false;
    if (!values.contains(name)) return Refuse(bus, call, QDBusError::UnknownProperty, name), true;
    if (isGet) return Reply(bus, call, {QVariant::fromValue(QDBusVariant(values.value(name)))}), true;
    const QVariant value = arguments.value(2).value<QDBusVariant>().variant();
    if (value.userType() != values.value(name).userType())
        return Refuse(bus, call, QDBusError::InvalidArgs, name), true;
    bool canBeSet = properties.Set != nullptr;
    if (canBeSet) RunCommand([&] { canBeSet = properties.Set(name, value); });
    if (canBeSet)
        Reply(bus, call);
    else
        Refuse(bus, call, QDBusError::PropertyReadOnly, name);
    return true;
}
