#include "linux/maps/DesktopMapsApplication.h"

#include <QUrl>

namespace ktr::linux_ {

namespace {

/// Seven digits tell centimetres apart.
QString degrees(double value) {
    QString text = QString::number(value, 'f', 7);
    while (text.endsWith(u'0')) {
        text.chop(1);
    }
    if (text.endsWith(u'.')) {
        text.chop(1);
    }
    return text == QStringLiteral("-0") ? QStringLiteral("0") : text;
}

}  // namespace

std::string DesktopMapsApplication::urlFor(const platform::MapItem& item) {
    const QString place = degrees(item.coordinate.latitude) + u',' + degrees(item.coordinate.longitude);
    QString url = QStringLiteral("geo:") + place;
    if (!item.name.empty()) {
        const QByteArray name = QUrl::toPercentEncoding(QString::fromStdString(item.name));
        url += QStringLiteral("?q=") + place + u'(' + QString::fromLatin1(name) + u')';
    }
    return url.toStdString();
}

bool DesktopMapsApplication::open(const platform::MapItem& item) {
    return isValid(item.coordinate) && opener_(urlFor(item));
}

}  // namespace ktr::linux_
