// The unit and asterisk conversions applied to the whole workspace after a download.
#include "FuzzInput.h"
#include "core/readings/ReadingConversions.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    FuzzInput in(data, size);
    const uint8_t flags = in.takeByte();
    ReadingConversions conversions;
    conversions.msToUs = flags & 1;
    conversions.ppkToPpm = flags & 2;
    conversions.asterisks = flags & 4;
    const QString text = FuzzInput::anyText(in.rest(), flags & 8);

    const QString once = conversions.apply(text);
    FUZZ_CHECK(once.size() == text.size(), text);
    const QString twice = conversions.apply(once);
    FUZZ_CHECK(twice == once, text + QLatin1Char('\n') + once + QLatin1Char('\n') + twice);
    if (conversions.asterisks)
        FUZZ_CHECK(!once.contains(u'*'), text);

    // One value field on its own: a number, "+OVR" or nothing.
    const QStringView field = QStringView(text).left(12);
    if (const auto value = ReadingConversions::convertValueField(field))
        FUZZ_CHECK(!value->isEmpty() && !value->contains(u'e') && !value->contains(u' '),
                   field.toString() + QStringLiteral(" -> ") + *value);
    return 0;
}
