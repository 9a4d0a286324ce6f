#pragma once

#include <QObject>
#include <QString>

#include <cstddef>
#include <cstdint>

class Dialogs;

// The standard CRC-32 (zip, gzip, PNG: reflected polynomial 0xEDB88320, initial value and
// final XOR 0xFFFFFFFF). The functions below work on the running value, before the final
// XOR, so a long input can be fed in pieces.
namespace crc32kernels {

inline constexpr std::uint32_t kPolynomial = 0xEDB88320u;
inline constexpr std::uint32_t kInitial = 0xFFFFFFFFu;

// Feeds bytes through the running value with the fastest kernel this processor has.
std::uint32_t update(std::uint32_t running, const unsigned char* data, std::size_t size);
// The portable kernel (eight bytes per step), used where no faster one exists.
std::uint32_t updatePortable(std::uint32_t running, const unsigned char* data, std::size_t size);
// The carry-less-multiply kernel; only callable when clmulAvailable() is true.
std::uint32_t updateClmul(std::uint32_t running, const unsigned char* data, std::size_t size);
bool clmulAvailable();

} // namespace crc32kernels

// Computes the CRC-32 of a file or of a text so that a ROM image can be identified in the
// game database. Results are the 32 bits of the CRC taken as a signed number, which is how
// the database stores them. Failures are shown in a message box titled with the failing
// operation's name; the caller gets whatever the result held at that moment.
class CCRC32 : public QObject {
    Q_OBJECT
    Q_PROPERTY(QString InputFileName READ InputFileName WRITE setInputFileName)
public:
    explicit CCRC32(Dialogs& dialogs, QObject* parent = nullptr);

    QString InputFileName() const { return m_inputFileName; }
    void setInputFileName(const QString& fileName) { m_inputFileName = fileName; }

    // The CRC of the whole file named by InputFileName; 0 (after a message) when it cannot
    // be opened. The file is only ever opened for reading.
    qint32 GetCRCFromFile();
    // The CRC of the text's UTF-16LE code units, two bytes per character.
    qint32 GetCRCFromString(const QString& text);

    // One step of the byte-at-a-time CRC: the running value after the byte b.
    static std::uint32_t UpdateCRC32(std::uint32_t crc, unsigned char b);

    // Bytes per read: the file is read in chunks of this size, except that a last piece of
    // up to one byte more is read whole.
    static constexpr qint64 kChunkSize = 32767;

signals:
    // The fraction of the work done, from 0 to 1.
    void Progress(float fraction);

private:
    void showError(const QString& operation, int number, const QString& description);

    Dialogs& m_dialogs;
    QString m_inputFileName;
};
