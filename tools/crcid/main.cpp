// lum_crcid LIST DATABASE
// Builds the game database DATABASE (CRCID.dat) from the text list LIST. A bad line stops
// the build with "LIST:LINE: error: ..." and leaves any earlier database untouched.

#include "library/GameDatabase.h"

#include <QFile>
#include <QSaveFile>

#include <cstdio>

int main(int argc, char** argv) {
    if (argc != 3) {
        std::fprintf(stderr, "usage: lum_crcid LIST DATABASE\n");
        return 2;
    }
    const QString listPath = QFile::decodeName(argv[1]);
    const QString databasePath = QFile::decodeName(argv[2]);

    QFile list(listPath);
    if (!list.open(QIODevice::ReadOnly)) {
        std::fprintf(stderr, "%s: error: cannot read the list: %s\n", argv[1],
                     qPrintable(list.errorString()));
        return 1;
    }
    const QByteArray text = list.readAll();
    const GameListParse parsed = parseGameList(text);
    if (parsed.error) {
        std::fprintf(stderr, "%s:%d: error: %s\n", argv[1], parsed.error->line,
                     parsed.error->message.toLocal8Bit().constData());
        return 1;
    }

    // Written beside the target and renamed into place, so a failure leaves no half file.
    QSaveFile database(databasePath);
    const QByteArray bytes = encodeGameDatabase(parsed.records);
    // Unbuffered: a buffered short write would only fail inside commit(), unnoticed.
    if (!database.open(QIODevice::WriteOnly | QIODevice::Unbuffered) ||
        database.write(bytes) != bytes.size() || !database.commit()) {
        std::fprintf(stderr, "%s: error: cannot write the database: %s\n", argv[2],
                     qPrintable(database.errorString()));
        return 1;
    }
    return 0;
}
