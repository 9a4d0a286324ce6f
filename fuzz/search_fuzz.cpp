// MatchesSearch with any expression and any file name: the input is the expression, a NUL
// byte and the name.
#include "FuzzSupport.h"

#include "library/Ascii.h"
#include "library/Search.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const auto [expression, name] = fuzz::twoTexts(data, size);
    const bool match = MatchesSearch(expression, name);
    // The name's letter case never matters (checked where case mapping is one to one).
    if (isAscii(name)) {
        FUZZ_CHECK(MatchesSearch(expression, name.toUpper()) == match);
        FUZZ_CHECK(MatchesSearch(expression, name.toLower()) == match);
    }
    // Without an operator the expression is one term, found as Qt finds it ignoring case.
    if (!expression.contains(QLatin1String("OR")) && !expression.contains(QLatin1String("AND")) &&
        !expression.contains(QLatin1String("NOT")))
        FUZZ_CHECK(match == (expression.isEmpty()
                                 ? !name.isEmpty()
                                 : name.contains(expression, Qt::CaseInsensitive)));
    return 0;
}
