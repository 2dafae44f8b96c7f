#pragma once

#include <QString>
#include <initializer_list>

// Keyword tests on the meter's replies search anywhere in the line and ignore letter case.
namespace replywords {

inline bool has(const QString& reply, const char* word) {
    return reply.contains(QLatin1String(word), Qt::CaseInsensitive);
}

inline bool hasAny(const QString& reply, std::initializer_list<const char*> words) {
    for (const char* w : words)
        if (has(reply, w))
            return true;
    return false;
}

// The reply a reading operation cannot go on with: nothing, or the meter busy or left.
inline bool unusable(const QString& reply) {
    return reply.isEmpty() || hasAny(reply, {"BUSY", "EXIT"});
}

} // namespace replywords
