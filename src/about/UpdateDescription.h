#pragma once

#include <QString>
#include <QtGlobal>

#include <optional>

class QIODevice;

// A program version as its three parts; its number packs them as
// major * 2^20 + minor * 2^10 + revision (minor and revision stay below 1024).
struct ProductVersion {
    QString name;
    int major = 0;
    int minor = 0;
    int revision = 0;
};

// This build's product name and version.
ProductVersion thisProduct();

qint64 versionNumber(const ProductVersion& version);
// "1.1.12": the parts as plain decimal numbers joined with ".".
QString versionText(const ProductVersion& version);
// The text of a packed version number: 1049613 gives "1.1.13".
QString versionTextFromNumber(qint64 number);
// The version line of a description file: a decimal number, blanks around it allowed.
// Anything else (empty, a sign, letters, too large) gives nothing.
std::optional<qint64> parseVersionNumber(const QString& line);

// True for "::" followed by exactly the product name. Lines shorter than three characters
// never qualify, so "::" alone does not match even an empty name.
bool isSectionHeader(const QString& line, const QString& productName);

// An installer file name must name a file inside the Update folder: not empty, not
// absolute, no path separator, no "..", no control characters.
bool isSafeInstallerFileName(const QString& name);

// An http or https address with a host: what the description may have the desktop open.
bool isWebAddress(const QString& text);

// An installer is fetched only over https from the host that served the description (the
// update server, `serverBase`); plain http only when the description itself came that way
// from that host, as from a local mirror, which the installer then trusts no less.
bool isTrustedInstallerAddress(const QString& address, const QString& serverBase);

// The section of the update description file that belongs to one product.
struct UpdateSection {
    enum class Status {
        NotFound,   // no header for the product
        Complete,   // every line the mode needs is there
        Truncated,  // the file ends inside the section
        BadVersion, // the version line is not a number
    };
    Status status = Status::NotFound;
    QString forumUrl;
    // The message lines without their apostrophes, as the message box shows them: an
    // empty first line, then each message line on its own. Empty when there were none.
    QString message;
    qint64 availableVersion = 0;
    QString releaseDate;
    QString installerUrl;
    QString installerFileName;
    QString runFlag;
};

// Reads the product's section from an update description file (lines end in CR LF or LF).
// With `forumOnly` reading stops after the forum line; otherwise after the run flag.
UpdateSection readUpdateSection(QIODevice& file, const QString& productName, bool forumOnly);
