#pragma once

#include <QString>
#include <QStringList>

// The one record of shared state. Owned by the main window and handed by reference to every
// subsystem, so each test can start from a fresh one. Field names follow the rest of the code.
struct AppState {
    // Serial link and command exchange.
    QString portName;
    QString portDevicePath;
    qint32 baudRate = 0;
    QString commandText;
    QString responseText; // one reply line, Latin-1 characters, ended by its CR
    double readTimeoutSec = 0;
    double commandStartTime = 0; // monotonic clock seconds
    bool abortRequested = false;
    bool flushing = false;
    bool commandResent = false;
    qint32 ioResult = 0;

    // Instrument identity and capabilities.
    QString modelCode;
    QString serialNumber;
    QString firmwareVersion;
    qint32 numLogged = 0;
    QString replyTail;
    QString replyText;
    QString capabilityText;
    bool percentFormat = false;
    bool hasLog = false;
    bool hasGLP = false;
    bool canAutoLog = false;
    bool canStir = false;
    bool isK5Family = false;
    bool hasMaxMin = false;

    // Readings and continuous operations.
    QString dataLine;
    QString headerText;
    QString positionText;
    int logColumnStart = 0;
    int logColumnWidth = 0;
    double runStartTime = 0; // monotonic clock seconds
    int lineCount = 0;
    int readingNumber = 0;
    bool runActive = false;
    bool stopRequested = false;

    // Workspace.
    QString workspaceText;
    bool workspaceSaved = false;
    QString undoText;
    QString undoHeader;
    int findTextLength = 0;
    qint32 findStart = 0;
    QString fileExistsChoice; // "Append", "Overwrite", "Rename" or "" when cancelled
    bool saveCancelled = false;

    // Help topics of the help window opened last.
    QStringList helpTopics;

    // Settings held in memory.
    double logInterval = 0;
    qint16 convertAsterisks = 0;
    qint16 convertMsToUs = 0;
    qint16 convertPpkToPpm = 0;
    QString catalogDrive;
    // The settings file could not be parsed when it was loaded; the next save moves it aside.
    bool settingsFileBroken = false;
};
