#include "HTTPRetrieval/WebAddress.h"

using namespace Qt::StringLiterals;

bool IsWebAddress(const QUrl& address) {
    return address.isValid() && !address.host().isEmpty() &&
           (address.scheme() == "http"_L1 || address.scheme() == "https"_L1);
}

QString AddressBase(QString address) {
    address = address.trimmed();
    while (address.endsWith(u'/'))
        address.chop(1);
    return address;
}
