#pragma once

#include <QByteArray>
#include <QString>
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>

// Helpers shared by the fuzz targets: turning the fuzzer's bytes into the program's inputs, and
// failing loudly when an invariant breaks (libFuzzer records the input that did it).
class FuzzInput {
public:
    FuzzInput(const uint8_t* data, size_t size)
        : data_(reinterpret_cast<const char*>(data)), size_(size) {}

    // One byte taken from the front (0 when nothing is left), for choices and small numbers.
    uint8_t takeByte() {
        if (pos_ >= size_)
            return 0;
        return static_cast<uint8_t>(data_[pos_++]);
    }
    // Bytes up to the next zero byte (which is consumed), or all that is left.
    QByteArray takePart() {
        size_t end = pos_;
        while (end < size_ && data_[end] != '\0')
            ++end;
        QByteArray part(data_ + pos_, qsizetype(end - pos_));
        pos_ = end < size_ ? end + 1 : end;
        return part;
    }
    QByteArray rest() {
        QByteArray r(data_ + pos_, qsizetype(size_ - pos_));
        pos_ = size_;
        return r;
    }

    // Wire bytes are single-byte characters; typed or opened text may hold any character.
    static QString wireText(const QByteArray& bytes) { return QString::fromLatin1(bytes); }
    static QString anyText(const QByteArray& bytes, bool utf16) {
        if (!utf16)
            return QString::fromLatin1(bytes);
        return QString(reinterpret_cast<const QChar*>(bytes.constData()), bytes.size() / 2);
    }

private:
    const char* data_;
    size_t size_;
    size_t pos_ = 0;
};

[[noreturn]] inline void fuzzFail(const char* what, const QString& detail) {
    std::fprintf(stderr, "broken invariant: %s\n%s\n", what, detail.toUtf8().constData());
    std::abort();
}

#define FUZZ_CHECK(condition, detail)                                                              \
    do {                                                                                           \
        if (!(condition))                                                                          \
            fuzzFail(#condition, detail);                                                          \
    } while (0)
