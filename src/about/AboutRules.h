#pragma once

#include <QPoint>
#include <QSize>
#include <QString>

#include <vector>

class QFont;

// The widest the product name may be: 4900 twips.
inline constexpr double kProgramLabelMaxTwips = 4900;

// The point size at which `text` in `font` is at most `maxWidth` pixels wide, reached by
// taking one point off at a time from the font's own size. Stops at 1 point, however
// wide the text still is.
double shrinkToFit(const QFont& font, const QString& text, int maxWidth);

// The top-left corners at which a tile is drawn to cover an area, column by column from
// the left, each column from the top. Both bounds are inclusive, so the last row and
// column may be cut by the edge. An empty tile covers nothing.
std::vector<QPoint> tileOrigins(QSize area, QSize tile);

// "mailto:<address>?Subject=<product> v<version> Question".
QString mailtoAddress(const QString& email, const QString& productName, const QString& version);

// The payment service's donation page: "/xclick/business=" with the payment address (its
// at sign as %40), then the site name and the fixed terms; no question mark.
QString donationAddress(const QString& service, const QString& email, const QString& siteName);
