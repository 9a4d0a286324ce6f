#pragma once

// Archives written by libarchive, for the code that reads them.

#include <archive.h>
#include <archive_entry.h>

#include <QFile>

#include <vector>

// An archive of named entries (null content: a folder) in a libarchive format ("zip", "7zip",
// "raw": one file, gzipped); a failure to write shows as the reader's outcome.
inline QString writeArchive(const QString& path, const char* format,
                            const std::vector<std::pair<const char*, QByteArray>>& entries,
                            const char* options = nullptr) {
    archive* writer = archive_write_new();
    archive_write_set_format_by_name(writer, format);
    if (QByteArray(format) == "raw")
        archive_write_add_filter_gzip(writer);
    if (options && archive_write_set_options(writer, options) == ARCHIVE_OK)
        archive_write_set_passphrase(writer, "secret");
    archive_write_open_filename(writer, QFile::encodeName(path));
    for (const auto& [name, bytes] : entries) {
        archive_entry* entry = archive_entry_new();
        archive_entry_set_pathname(entry, name);
        archive_entry_set_mode(entry, (bytes.isNull() ? AE_IFDIR : AE_IFREG) | 0644);
        archive_entry_set_size(entry, bytes.size());
        archive_write_header(writer, entry);
        archive_write_data(writer, bytes.constData(), bytes.size());
        archive_entry_free(entry);
    }
    archive_write_free(writer);
    return path;
}
