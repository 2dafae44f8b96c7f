// The meter's reply to "?S" (all three formats) and to "?W", as received from the wire.
#include "FuzzInput.h"
#include "core/instrument/StatusReply.h"

#include <QStringList>

namespace {
// Model codes a previous status query may have left behind; they steer the plain format.
const QStringList kHeldCodes = {"", "QR32", "ZUM410", "K51", "K50", "CD200", "K5AH", "QR34"};

bool noSpace(const std::optional<QString>& field) {
    return !field || !field->contains(u' ');
}
} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    FuzzInput in(data, size);
    const QString held = kHeldCodes.value(in.takeByte() % kHeldCodes.size());
    const QString reply = FuzzInput::wireText(in.takePart());
    const QString second = FuzzInput::wireText(in.rest());

    StatusReply status = parseStatusReply(reply, held);
    FUZZ_CHECK(!status.numLogged || *status.numLogged >= 0, reply);
    FUZZ_CHECK(reply.contains(status.capabilityText), reply);
    const bool unusable = reply.isEmpty() || reply.contains(u"BUSY", Qt::CaseInsensitive) ||
                          reply.contains(u"EXIT", Qt::CaseInsensitive);
    FUZZ_CHECK(unusable == (status.format == StatusReply::Format::Unusable), reply);
    if (status.format == StatusReply::Format::Plain ||
        status.format == StatusReply::Format::Percent) {
        // Words end at a space, so a field never holds one.
        FUZZ_CHECK(noSpace(status.firmwareVersion) && noSpace(status.serialNumber), reply);
    }
    if (status.needsVersionQuery) {
        FUZZ_CHECK(status.modelCode == QStringLiteral("QR32"), reply);
        parseVersionReply(second, status);
        // A field whose characters are not all there is not delivered.
        FUZZ_CHECK(status.firmwareVersion.has_value() == (second.size() >= 11), second);
        FUZZ_CHECK(status.serialNumber.has_value() == (second.size() >= 18), second);
    }
    const auto count = parseCount(second);
    FUZZ_CHECK(!count || *count >= 0, second);
    return 0;
}
