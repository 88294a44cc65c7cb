#pragma once

#include <QString>
#include <QUrl>

// Addresses of the web as users write them.

// An address of HTTP or HTTPS with a host.
bool IsWebAddress(const QUrl& address);

// The beginning of other addresses: without blanks around it and slashes at its end.
QString AddressBase(QString address);
