#pragma once

#include <QDBusConnection>
#include <QDBusMessage>
#include <QVariantMap>
#include <functional>

// The interface by which the bus asks for properties.
QString PropertiesInterface();

struct BusProperties {
    std::function<QVariantMap(const QString& interface)> Of;
    // Unset: none can be set.
    std::function<void(const QString& name, const QVariant& value)> Set{};
};

// Answers a call of that interface; false when it has no such method.
bool AnswerProperties(const BusProperties& properties, const QDBusMessage& call, const QDBusConnection& bus);
