#include "core/instrument/StatusReply.h"

#include "core/instrument/ModelTable.h"

namespace {

bool isAsciiDigit(QChar c) {
    return c >= u'0' && c <= u'9';
}

qsizetype skipSpaces(const QString& text, qsizetype from) {
    while (from < text.size() && text[from] == u' ')
        ++from;
    return from;
}

// A word that starts at `from` and is closed by a space. Returns the position of that space, or
// -1 when the closing space is missing (the word is then not taken).
qsizetype wordAt(const QString& text, qsizetype from, std::optional<QString>& word) {
    const qsizetype end = from <= text.size() ? text.indexOf(u' ', from) : -1;
    if (end >= 0)
        word = text.mid(from, end - from);
    return end;
}

// The serial number of a plain reply: a meter without a log sends nothing after it, so the
// reply's closing CR ends it as well as a space does.
void serialAt(const QString& text, qsizetype from, std::optional<QString>& serial) {
    if (wordAt(text, from, serial) >= 0)
        return;
    const qsizetype cr = text.indexOf(u'\r', from);
    if (cr >= 0)
        serial = text.mid(from, cr - from);
}

void parsePlain(const QString& reply, const QString& currentModelCode, StatusReply& r) {
    std::optional<QString> second;
    const qsizetype modelEnd = wordAt(reply, 0, r.modelCode);
    qsizetype secondEnd = -1;
    if (modelEnd >= 0)
        secondEnd = wordAt(reply, skipSpaces(reply, modelEnd), second);

    const QString model = r.modelCode.value_or(currentModelCode);
    if (modeltable::usesQr32StatusLayout(model)) {
        r.modelCode = modeltable::qr32Code();
        if (second)
            r.numLogged = parseCount(*second);
        r.needsVersionQuery = true;
    } else {
        r.firmwareVersion = second;
        if (secondEnd >= 0)
            serialAt(reply, skipSpaces(reply, secondEnd), r.serialNumber);
    }

    const QString held = r.modelCode.value_or(currentModelCode);
    r.hasLog = modeltable::plainKeepsLog(held);
    r.hasGLP = r.hasLog && modeltable::plainKeepsGlp(held);
    if (r.hasLog && !r.needsVersionQuery && reply.size() >= 5) {
        r.replyTail = reply.right(5);
        r.numLogged = parseCount(r.replyTail->left(4));
    }
    r.capabilityText.clear();
}

void parseK5(const QString& reply, const QString& currentModelCode, StatusReply& r) {
    r.isK5Family = true;
    std::optional<QString> firstWord;
    if (wordAt(reply, 0, firstWord) >= 0)
        r.modelCode = modeltable::normaliseK5Code(*firstWord);
    r.firmwareVersion = QString();

    // The logged count is the first run of digits from the third character on (the "5" of
    // "K5" is not part of it).
    qsizetype start = 2;
    while (start < reply.size() && !isAsciiDigit(reply[start]))
        ++start;
    if (start < reply.size()) {
        qsizetype end = start;
        while (end < reply.size() && isAsciiDigit(reply[end]))
            ++end;
        r.replyTail = reply.mid(start, end - start);
        r.numLogged = parseCount(*r.replyTail);
    }

    const QString held = r.modelCode.value_or(currentModelCode);
    if (modeltable::k5ReportsSerial(held))
        r.serialNumber = reply.size() >= 6 ? reply.mid(reply.size() - 6, 5) : QString();
    else
        r.serialNumber = QString();
    r.hasGLP = modeltable::k5KeepsGlp(held);
    r.hasLog = true;
    r.capabilityText = reply;
}

void parsePercent(const QString& reply, StatusReply& r) {
    // The letter after the first "%" says which records the meter keeps.
    const qsizetype percent = reply.indexOf(u'%');
    const QString letter = reply.mid(percent + 1, 1);
    r.hasLog = letter != u"n" && letter != u"l";
    r.hasGLP = letter != u"n" && letter != u"g";
    r.isK5Family = modeltable::isK5FamilyCode(reply);

    // Fields are separated by exactly one space; the first missing closing space ends them.
    std::optional<QString> count;
    std::optional<QString>* fields[] = {&r.modelCode, &r.firmwareVersion, &r.serialNumber, &count};
    const int fieldCount = r.hasLog ? 4 : 3;
    qsizetype lastEnd = -1;
    for (int i = 0; i < fieldCount; ++i) {
        const qsizetype end = wordAt(reply, lastEnd + 1, *fields[i]);
        if (end < 0)
            break;
        lastEnd = end;
    }
    if (count)
        r.numLogged = parseCount(*count);

    const qsizetype capStart = lastEnd + 1;
    const qsizetype capEnd = reply.indexOf(u'%', capStart);
    r.capabilityText = capEnd >= 0 ? reply.mid(capStart, capEnd - capStart) : QString();
}

} // namespace

std::optional<qint32> parseCount(const QString& field) {
    const QString digits = field.trimmed();
    if (digits.isEmpty())
        return std::nullopt;
    for (QChar c : digits) {
        if (!isAsciiDigit(c))
            return std::nullopt;
    }
    bool ok = false;
    const qint32 value = digits.toInt(&ok);
    return ok ? std::optional<qint32>(value) : std::nullopt;
}

StatusReply parseStatusReply(const QString& reply, const QString& currentModelCode) {
    StatusReply r;
    if (reply.isEmpty() || reply.contains(u"BUSY", Qt::CaseInsensitive) ||
        reply.contains(u"EXIT", Qt::CaseInsensitive)) {
        r.format = StatusReply::Format::Unusable;
    } else if (reply.startsWith(u"ERROR")) {
        r.format = StatusReply::Format::Error;
    } else if (reply.contains(u'%')) {
        r.format = StatusReply::Format::Percent;
        parsePercent(reply, r);
    } else if (modeltable::isK5FamilyCode(reply)) {
        r.format = StatusReply::Format::K5;
        parseK5(reply, currentModelCode, r);
    } else {
        r.format = StatusReply::Format::Plain;
        parsePlain(reply, currentModelCode, r);
    }
    return r;
}

void parseVersionReply(const QString& reply, StatusReply& status) {
    // Each field is taken when all its characters are there, so a short reply keeps what it has.
    if (reply.size() >= 11)
        status.firmwareVersion = reply.mid(8, 3);
    if (reply.size() >= 18)
        status.serialNumber = reply.mid(12, 6);
}
