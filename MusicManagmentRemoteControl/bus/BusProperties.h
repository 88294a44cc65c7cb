#pragma once

#include <QDBusConnection>
#include <QDBusMessage>
#include <QVariantMap>
#include <functional>

// The interface by which the bus asks for properties.
QString PropertiesInterface();

struct BusProperties {
    std::function<QVariantMap(const QString& interface)> Of;
    // Gets a value of the property's own type; false for a property that cannot be set. Unset: none can be.
    std::function<bool(const QString& name, const QVariant& value)> Set{};
};

// Answers a call of that interface; false when it has no such method.
bool AnswerProperties(const BusProperties& properties, const QDBusMessage& call, const QDBusConnection& bus);
