#pragma once

#include <QObject>

class MainWindow;

// Help windows, about boxes and the catalogue.
class HelpCommands : public QObject {
    Q_OBJECT
public:
    explicit HelpCommands(MainWindow& window);

private:
    MainWindow& w_;
};
