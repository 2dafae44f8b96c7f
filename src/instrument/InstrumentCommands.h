#pragma once

#include <QObject>

class MainWindow;

// Status query, capability display and the control commands of the meter.
class InstrumentCommands : public QObject {
    Q_OBJECT
public:
    explicit InstrumentCommands(MainWindow& window);

    // Exchanges "?S", parses the reply and shows identity and commands.
    void QueryStatus();

private:
    MainWindow& w_;
};
