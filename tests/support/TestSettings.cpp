#include "TestSettings.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>
#include <QSettings>

namespace {
QString firstRunApplication() {
    return QFileInfo(QCoreApplication::applicationFilePath()).completeBaseName();
}
} // namespace

TestSettings::TestSettings() : oldHome_(qgetenv("HOME")) {
    QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, dir_.filePath("config"));
    QSettings::setPath(QSettings::IniFormat, QSettings::UserScope, dir_.filePath("config"));
    QDir(dir_.path()).mkpath(QStringLiteral("home/Documents"));
    qputenv("HOME", dir_.filePath("home").toLocal8Bit());
    qputenv("XDG_DOCUMENTS_DIR", dir_.filePath("home/Documents").toLocal8Bit());
}

TestSettings::~TestSettings() {
    qputenv("HOME", oldHome_);
}

void TestSettings::set(const QString& key, const QString& value) {
    QSettings s(QStringLiteral("Telvio"), QStringLiteral("Telvio"));
    s.setValue(QStringLiteral("Settings/") + key, value);
}

QString TestSettings::value(const QString& key) const {
    QSettings s(QStringLiteral("Telvio"), QStringLiteral("Telvio"));
    return s.value(QStringLiteral("Settings/") + key).toString();
}

void TestSettings::markFirstRunDone() {
    QSettings s(QStringLiteral("Telvio"), firstRunApplication());
    s.setValue(QStringLiteral("Settings/FirstRun"), QStringLiteral("False"));
}

void TestSettings::clearFirstRun() {
    QSettings s(QStringLiteral("Telvio"), firstRunApplication());
    s.remove(QStringLiteral("Settings/FirstRun"));
}

QString TestSettings::firstRunValue() const {
    QSettings s(QStringLiteral("Telvio"), firstRunApplication());
    return s.value(QStringLiteral("Settings/FirstRun")).toString();
}
