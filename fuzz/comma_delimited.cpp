// Workspace text turned into comma-delimited lines for a .csv file.
#include "FuzzInput.h"
#include "core/text/CommaDelimited.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    FuzzInput in(data, size);
    const bool utf16 = in.takeByte() & 1;
    const QString text = FuzzInput::anyText(in.rest(), utf16);

    const QString csv = CommaDelimited::convert(text);
    // Characters are only dropped or turned into commas and spaces: never more lines, never
    // a longer text, never a character that was not there.
    FUZZ_CHECK(csv.count(u'\n') <= text.count(u'\n'), text);
    FUZZ_CHECK(csv.size() <= text.size(), text + QLatin1Char('\n') + csv);
    for (const QChar c : csv)
        FUZZ_CHECK(c == u',' || c == u' ' || text.contains(c), text + QLatin1Char('\n') + csv);
    return 0;
}
