// Log records as the meter sends them during a download: the general, two-digit-year, K5,
// marin/lago and percent layouts, and the fixed QR32 record.
#include "FuzzInput.h"
#include "core/readings/LogLineFormat.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    FuzzInput in(data, size);
    const uint8_t flags = in.takeByte();
    const qsizetype extra = in.takeByte() % 8;
    const QString record = FuzzInput::wireText(in.rest());

    LineLayout layout;
    layout.percentFormat = flags & 1;
    layout.hasLog = flags & 2;
    layout.isK5Family = flags & 4;
    layout.marinLago = flags & 8;
    layout.qr32 = flags & 16;

    const auto line = LogLineFormat::reformat(record, layout);
    if (layout.percentFormat)
        FUZZ_CHECK(line && *line == record, record);
    else if (line)
        // The date/time field moves to the front; only a two-digit year grows it (to 20
        // characters), so a line is at most 3 characters longer than its record (9 for the
        // K5 layout, whose 11-character field can grow the same way).
        FUZZ_CHECK(line->size() <= record.size() + (layout.isK5Family ? 9 : 3), record);

    const auto qr32 = LogLineFormat::qr32Record(record);
    if (qr32) {
        FUZZ_CHECK(qr32->size() == record.size() + 2, record);
    } else {
        FUZZ_CHECK(record.size() < LogLineFormat::kMinQr32, record);
    }
    const auto fixed = LogLineFormat::qr32Fixed(record, extra);
    FUZZ_CHECK(fixed.has_value() == (record.size() >= LogLineFormat::kMinQr32 + extra), record);
    if (fixed)
        FUZZ_CHECK(fixed->left(6 + extra) == record.left(6 + extra), record);
    return 0;
}
