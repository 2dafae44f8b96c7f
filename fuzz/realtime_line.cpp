// The meter's reply to "?D" turned into one real-time line, for every line layout.
#include "FuzzInput.h"
#include "core/readings/RealTimeLine.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    FuzzInput in(data, size);
    const uint8_t flags = in.takeByte();
    RealTimeLine::Context context;
    context.layout.percentFormat = flags & 1;
    context.layout.hasLog = flags & 2;
    context.layout.isK5Family = flags & 4;
    context.layout.marinLago = flags & 8;
    context.layout.qr32 = flags & 16;
    context.logColumnKnown = flags & 32;
    context.logColumnStart = int(int8_t(in.takeByte()));
    context.logColumnWidth = int(int8_t(in.takeByte()));
    // Reading numbers run from 1 up; a very long run still must not break the line.
    const int readingNumber = (in.takeByte() << 16) | (in.takeByte() << 8) | in.takeByte();
    context.now = QDateTime(QDate(2004, 3, 12), QTime(10, 15, 0));
    const QString reply = FuzzInput::wireText(in.rest());

    const auto line = RealTimeLine::build(reply, readingNumber, context);
    const QString number = RealTimeLine::numberText(readingNumber);
    FUZZ_CHECK(number.size() >= 4 && number.trimmed() == QString::number(readingNumber), number);
    if (!line)
        return 0;
    const LineLayout& l = context.layout;
    if (l.percentFormat && l.hasLog) {
        // The meter's own Log# field is overwritten in place: the line keeps its length.
        FUZZ_CHECK(line->size() == reply.size(), reply);
    } else if (l.percentFormat) {
        FUZZ_CHECK(line->endsWith(reply) && line->size() == reply.size() + 21 + number.size(),
                   reply);
    }
    return 0;
}
