#include "core/text/WorkspaceFileIO.h"

#include "core/text/DelimitedFieldReader.h"
#include "core/text/TextFileCodec.h"

#include <QFile>
#include <QSaveFile>

bool WorkspaceFileIO::readForDisplay(const QString& path, QString& text, QString& error) {
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly)) {
        error = file.errorString();
        return false;
    }
    QString decoded;
    {
        const QByteArray bytes = file.readAll();
        if (file.error() != QFileDevice::NoError) {
            error = file.errorString();
            return false;
        }
        decoded = TextFileCodec::decode(bytes);
    }
    text = DelimitedFieldReader::toWorkspaceText(decoded);
    return true;
}

bool WorkspaceFileIO::write(const QString& path, const QString& text, bool append, QString& error) {
    const QByteArray bytes = TextFileCodec::encode(text);
    if (append) {
        QFile file(path);
        if (!file.open(QIODevice::WriteOnly | QIODevice::Append)) {
            error = file.errorString();
            return false;
        }
        // A full disk can take part of the text: cut the file back to what it held before.
        const qint64 before = file.size();
        if (file.write(bytes) != bytes.size() || !file.flush()) {
            error = file.errorString();
            file.resize(before);
            return false;
        }
        file.close();
        if (file.error() != QFileDevice::NoError) {
            error = file.errorString();
            QFile::resize(path, before);
            return false;
        }
        return true;
    }
    QSaveFile file(path);
    if (!file.open(QIODevice::WriteOnly)) {
        error = file.errorString();
        return false;
    }
    if (file.write(bytes) != bytes.size()) {
        error = file.errorString();
        file.cancelWriting();
        return false;
    }
    if (!file.commit()) {
        error = file.errorString();
        return false;
    }
    return true;
}
