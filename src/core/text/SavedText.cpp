#include "core/text/SavedText.h"

#include "core/text/CommaDelimited.h"

QString SavedText::contents(QString text, bool commaDelimited, bool asteriskSetting, bool glpData,
                            const QString& shownHeader) {
    if ((commaDelimited || asteriskSetting) && !glpData)
        text.replace(u'*', u'.');
    if (commaDelimited)
        return CommaDelimited::convert(text);
    if (!shownHeader.isEmpty())
        return shownHeader + QStringLiteral("\r\n") + text;
    return text;
}
