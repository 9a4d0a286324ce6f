// The ROM file pattern (ROMFilter, typed by the user) against any file name: the input is
// the pattern, a NUL byte and the name.
#include "FuzzSupport.h"

#include "library/Ascii.h"
#include "library/FileLister.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const auto [pattern, name] = fuzz::twoTexts(data, size);
    const FilePattern filter(pattern);
    const bool match = filter.matches(name);
    // "*" and "*.*" take every name; a pattern that is the name itself takes it.
    FUZZ_CHECK(FilePattern(QStringLiteral("*")).matches(name));
    FUZZ_CHECK(FilePattern(QStringLiteral("*.*")).matches(name));
    if (!name.contains(u';') && !name.contains(u'*') && !name.contains(u'?') &&
        !name.trimmed().isEmpty() && name.trimmed() == name)
        FUZZ_CHECK(FilePattern(name).matches(name));
    // Adding alternatives never loses a name.
    if (match)
        FUZZ_CHECK(FilePattern(pattern + QStringLiteral(";x")).matches(name));
    // Folders match plain ASCII names through a quicker path, which must agree.
    if (filter.asciiOnly() && isAscii(name))
        FUZZ_CHECK(filter.matchesFoldedAscii(name.toLower().toStdString()) == match);
    return 0;
}
