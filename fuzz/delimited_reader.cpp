// A file opened for display, read item by item as a delimited-field input, and its bytes
// decoded as UTF-8 or Latin-1.
#include "FuzzInput.h"
#include "core/text/DelimitedFieldReader.h"
#include "core/text/TextFileCodec.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    FuzzInput in(data, size);
    const QByteArray bytes = in.rest();
    const QString text = TextFileCodec::decode(bytes);
    // Every byte is one character (Latin-1) or part of one (UTF-8): never more characters.
    FUZZ_CHECK(text.size() <= bytes.size(), text);

    const QString shown = DelimitedFieldReader::toWorkspaceText(text);
    FUZZ_CHECK(shown.isEmpty() || shown.endsWith(u'\n'), text + QStringLiteral("\n--\n") + shown);
    // Items lose quotes, commas, blanks and line ends; nothing new is added but line feeds.
    for (const QChar c : shown)
        FUZZ_CHECK(c == u'\n' || text.contains(c), text + QStringLiteral("\n--\n") + shown);

    // Saving what was shown and opening it again shows the same characters.
    const QByteArray saved = TextFileCodec::encode(shown);
    FUZZ_CHECK(!saved.isEmpty() || shown.isEmpty(), shown);
    return 0;
}
