#include "core/readings/ListenReader.h"

#include "core/readings/ReplyWords.h"

std::optional<QString> ListenReader::take(int byte) {
    line_.append(QChar(char16_t(byte)));
    if (byte != 13 && line_.size() < kMaxLineLength)
        return std::nullopt;
    last_ = line_;
    line_.clear();
    if (replywords::hasAny(last_, {"ENDS", "BUSY", "EXIT", "ERROR"}))
        return std::nullopt;
    return last_;
}
