#include "about/AboutRules.h"

#include <QFont>
#include <QFontMetrics>

double shrinkToFit(const QFont& font, const QString& text, int maxWidth) {
    QFont sized = font;
    double points = font.pointSizeF();
    while (points > 1 && QFontMetrics(sized).horizontalAdvance(text) > maxWidth) {
        points = std::max(1.0, points - 1);
        sized.setPointSizeF(points);
    }
    return points;
}

std::vector<QPoint> tileOrigins(QSize area, QSize tile) {
    std::vector<QPoint> origins;
    if (tile.width() <= 0 || tile.height() <= 0 || area.width() < 0 || area.height() < 0)
        return origins;
    origins.reserve(std::size_t(area.width() / tile.width() + 1) *
                    std::size_t(area.height() / tile.height() + 1));
    for (int x = 0; x <= area.width(); x += tile.width())
        for (int y = 0; y <= area.height(); y += tile.height())
            origins.emplace_back(x, y);
    return origins;
}

QString mailtoAddress(const QString& email, const QString& productName, const QString& version) {
    return QStringLiteral("mailto:") + email + QStringLiteral("?Subject=") + productName +
           QStringLiteral(" v") + version + QStringLiteral(" Question");
}

QString donationAddress(const QString& service, const QString& email, const QString& siteName) {
    QString business = email;
    business.replace(u'@', QStringLiteral("%40"));
    return service + QStringLiteral("/xclick/business=") + business +
           QStringLiteral("&item_name=") + siteName +
           QStringLiteral("&no_note=1&tax=0&currency_code=USD");
}
