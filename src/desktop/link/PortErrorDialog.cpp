#include "desktop/link/PortErrorDialog.h"

#include <QApplication>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QStyle>
#include <QVBoxLayout>

QString PortErrorDialog::messageText(Kind kind, const QString& portName) {
    if (kind == Kind::InUse)
        return QStringLiteral("Serial port ") + portName +
               QStringLiteral(" is in use.  Exit the program that is accessing this port, or go to "
                              "setup and select alternative serial port.");
    return QStringLiteral("Serial port ") + portName +
           QStringLiteral(" cannot be found.  Please go to setup and select an alternative serial "
                          "port.");
}

PortErrorDialog::PortErrorDialog(Kind kind, const QString& portName, QWidget* parent)
    : QDialog(parent) {
    setObjectName(kind == Kind::InUse ? QStringLiteral("frmSerialPortInUse")
                                      : QStringLiteral("frmSerialPortUnavailable"));
    setWindowTitle(QString());
    setModal(true);
    auto* layout = new QVBoxLayout(this);
    auto* row = new QHBoxLayout;
    auto* image = new QLabel(this);
    image->setObjectName(QStringLiteral("Image1"));
    image->setPixmap(style()->standardIcon(QStyle::SP_MessageBoxWarning).pixmap(32, 32));
    auto* message = new QLabel(messageText(kind, portName), this);
    message->setObjectName(QStringLiteral("lblMessage"));
    message->setWordWrap(true);
    row->addWidget(image);
    row->addWidget(message, 1);
    layout->addLayout(row);
    auto* buttons = new QHBoxLayout;
    auto* retry = new QPushButton(QStringLiteral("&Retry"), this);
    auto* setup = new QPushButton(QStringLiteral("&Setup"), this);
    auto* cancel = new QPushButton(QStringLiteral("&Cancel"), this);
    retry->setObjectName(QStringLiteral("cmdRetry"));
    setup->setObjectName(QStringLiteral("cmdSetup"));
    cancel->setObjectName(QStringLiteral("cmdCancel"));
    retry->setDefault(true);
    for (QPushButton* b : {retry, setup, cancel})
        buttons->addWidget(b);
    layout->addLayout(buttons);
    connect(retry, &QPushButton::clicked, this, [this] {
        choice_ = Choice::Retry;
        accept();
    });
    connect(setup, &QPushButton::clicked, this, [this] {
        choice_ = Choice::Setup;
        accept();
    });
    connect(cancel, &QPushButton::clicked, this, [this] {
        choice_ = Choice::Cancel;
        reject();
    });
}
