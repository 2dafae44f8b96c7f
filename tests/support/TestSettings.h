#pragma once

#include <QString>
#include <QTemporaryDir>

// Points QSettings and the home folder (documents, data folder) at a temporary folder for the
// lifetime of the object, so tests never touch a user's real settings or files.
class TestSettings {
public:
    TestSettings();
    ~TestSettings();

    // A value of the program's settings section.
    void set(const QString& key, const QString& value);
    QString value(const QString& key) const;
    // Marks the first start as done, so no setup wizard runs.
    void markFirstRunDone();
    void clearFirstRun();
    QString firstRunValue() const;
    QString folder() const { return dir_.path(); }

private:
    QTemporaryDir dir_;
    QByteArray oldHome_;
};
