#pragma once

#include "core/readings/ListenReader.h"

#include <QMetaObject>
#include <QObject>
#include <QString>

class MainWindow;
struct AppState;

// Listen mode: takes the lines the meter prints by itself and appends each as its CR arrives.
// Driven by the port's bytesArrived signal, so an idle line costs no processor time.
class ListenMode : public QObject {
    Q_OBJECT
public:
    explicit ListenMode(MainWindow& window);

    // cmdListen and mnuListen: starts listening and returns; Stop ends it.
    void ListenForData();
    bool isListening() const { return listening_; }
    // No more bytes are taken; a line without its CR yet is dropped.
    void stopListening();
    // After Stop has restored the window: an empty workspace loses the check mark.
    void afterStop();

    // Bytes taken in one turn of the event loop.
    static constexpr int kBytesPerTurn = 65536;

private:
    void onBytesArrived();
    void onPortFailed();
    // The port failed while listening: listening ends with the link dialog.
    void fail();

    MainWindow& w_;
    AppState& s_;
    QMetaObject::Connection bytesConnection_;
    QMetaObject::Connection failConnection_;
    ListenReader reader_;
    bool listening_ = false;
    bool reading_ = false;
};
