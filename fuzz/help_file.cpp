// The two help files read beside the program: blocks ended by "#" lines, any line ends.
#include "FuzzInput.h"
#include "core/text/HelpFile.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    FuzzInput in(data, size);
    const HelpKind kind = in.takeByte() & 1 ? HelpKind::Other : HelpKind::General;
    const int count = HelpFile::topicCount(kind);
    const QString text = HelpFile::decode(in.rest());

    const QStringList topics = HelpFile::parseBlocks(text, count);
    FUZZ_CHECK(topics.size() == count, text);
    for (const QString& topic : topics) {
        // Every line of a topic ends with CR LF; "#" lines belong to no topic.
        FUZZ_CHECK(topic.isEmpty() || topic.endsWith(QStringLiteral("\r\n")), topic);
        FUZZ_CHECK(!topic.startsWith(QStringLiteral("#\r\n")), topic);
        FUZZ_CHECK(!topic.contains(QStringLiteral("\r\n#\r\n")), topic);
    }
    const QString printed = HelpFile::composePrintText(topics, HelpFile::printIndex(kind));
    FUZZ_CHECK(printed.endsWith(QStringLiteral("\r\n\r\n\r\n")) || HelpFile::printIndex(kind) == 0,
               printed);
    return 0;
}
