#include "help/ProgramFolder.h"

#include <QCoreApplication>

QString programFolder() {
    const QString over = qEnvironmentVariable("TELVIO_DATA_DIR");
    if (!over.isEmpty())
        return over;
    return QCoreApplication::applicationDirPath();
}
