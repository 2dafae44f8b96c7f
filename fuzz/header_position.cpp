// The percent meters' column header ("?H") and column positions ("?P"): where Log# stands.
#include "FuzzInput.h"
#include "core/readings/HeaderPosition.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    FuzzInput in(data, size);
    const QString header = FuzzInput::wireText(in.takePart());
    const QString position = FuzzInput::wireText(in.rest());

    const auto column = HeaderPosition::findLogColumn(header, position);
    if (column.found) {
        FUZZ_CHECK(column.start >= 1 && column.width >= 1, header + QLatin1Char('|') + position);
        FUZZ_CHECK(header.contains(u"Log", Qt::CaseInsensitive), header);
    }
    FUZZ_CHECK(HeaderPosition::headerFor(header, true) == header, header);
    FUZZ_CHECK(HeaderPosition::headerFor(header, false).endsWith(header), header);
    return 0;
}
