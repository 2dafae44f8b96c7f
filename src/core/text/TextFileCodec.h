#pragma once

#include <QByteArray>
#include <QString>

// How workspace text becomes file bytes and back. The instrument's characters are single
// bytes, so Latin-1 keeps them exactly; text that does not fit (typed or opened from a UTF-8
// file) is written as UTF-8. Reading takes UTF-8 when the bytes are valid UTF-8, else Latin-1,
// so a file saved and opened again shows the same characters.
class TextFileCodec {
public:
    static QByteArray encode(const QString& text);
    static QString decode(const QByteArray& bytes);
};
