#pragma once

#include <QObject>

class MainWindow;

// Log download, real-time readings, GLP and max/min records, listen mode and the Stop button.
class ReadingCommands : public QObject {
    Q_OBJECT
public:
    explicit ReadingCommands(MainWindow& window);

    // "?H" and "?P" of percent-format meters: headerText, positionText, Log# column.
    void GetHeaderAndPosition();
    // The Stop button, shared by the three continuous operations.
    void cmdStopCurrentData_Click();

private:
    MainWindow& w_;
};
