// The update description file as the server might send it: any bytes, read in both modes.
#include "FuzzSupport.h"

#include "about/UpdateDescription.h"

#include <QBuffer>

namespace {

const QString kProduct = QStringLiteral("lum (Windows Front End for z26)");

UpdateSection read(const QByteArray& text, bool forumOnly) {
    QBuffer file;
    file.setData(text);
    file.open(QIODevice::ReadOnly);
    return readUpdateSection(file, kProduct, forumOnly);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const QByteArray text = fuzz::bytes(data, size);

    const UpdateSection update = read(text, false);
    if (update.status == UpdateSection::Status::Complete) {
        FUZZ_CHECK(update.availableVersion >= 0);
        // The version arithmetic of the question must hold for any number that parses.
        FUZZ_CHECK(!versionTextFromNumber(update.availableVersion).isEmpty());
    }
    if (!update.message.isEmpty())
        FUZZ_CHECK(update.message.startsWith(u'\n') && update.message.endsWith(u'\n'));
    // A name that passes the check can only name a file inside the Update folder.
    if (isSafeInstallerFileName(update.installerFileName)) {
        const QString& name = update.installerFileName;
        FUZZ_CHECK(!name.contains(u'/') && !name.contains(u'\\') && !name.contains(u".."));
    }

    // Forum mode reads a prefix of what update mode reads: it never finds a different
    // section.
    const UpdateSection forum = read(text, true);
    FUZZ_CHECK((forum.status == UpdateSection::Status::NotFound) ==
               (update.status == UpdateSection::Status::NotFound));
    if (forum.status == UpdateSection::Status::Complete)
        FUZZ_CHECK(forum.forumUrl == update.forumUrl);

    // Each line read alone as a version line.
    for (const QByteArray& line : text.split('\n')) {
        if (const std::optional<qint64> version = parseVersionNumber(QString::fromUtf8(line)))
            FUZZ_CHECK(*version >= 0);
    }
    return 0;
}
