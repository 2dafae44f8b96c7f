#include "cli/CliLink.h"
#include "cli/Commands.h"
#include "core/text/WorkspaceFileIO.h"

#include <QFile>

bool Commands::writeOut(const QString& path, const QString& text) {
    if (path.isEmpty() || path == QLatin1String("-")) {
        QFile out;
        if (out.open(stdout, QIODevice::WriteOnly) && out.write(text.toLatin1()) == text.size() &&
            out.flush())
            return true;
        complain(QStringLiteral("cannot write to standard output: ") + out.errorString());
        return false;
    }
    QString error;
    if (WorkspaceFileIO::write(path, text, false, error))
        return true;
    complain(error);
    return false;
}
