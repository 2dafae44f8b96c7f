#include "desktop/link/CommsPortDialog.h"

#include "core/Prompts.h"
#include "core/link/PortNames.h"
#include "core/link/PortProbe.h"

#include <QComboBox>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QVBoxLayout>
#include <limits>

QStringList CommsPortDialog::speeds() {
    return {QStringLiteral("1200"), QStringLiteral("4800"), QStringLiteral("9600"),
            QStringLiteral("19200"), QStringLiteral("38400")};
}

CommsPortDialog::CommsPortDialog(const QString& portName, qint32 baudRate, Prompts& prompts,
                                 QWidget* parent)
    : QDialog(parent), prompts_(prompts) {
    setObjectName(QStringLiteral("frmCommsPort"));
    setWindowTitle(QStringLiteral("  Configure  Communications  Port"));
    setModal(true);
    auto* layout = new QVBoxLayout(this);
    auto addNote = [&](const char* text) {
        auto* l = new QLabel(QString::fromLatin1(text), this);
        l->setWordWrap(true);
        layout->addWidget(l);
    };
    layout->addWidget(new QLabel(QStringLiteral("Serial port"), this));
    cboCom_ = new QComboBox(this);
    cboCom_->setObjectName(QStringLiteral("cboCom"));
    cboCom_->setEditable(true);
    layout->addWidget(cboCom_);
    addNote("*   Select  the  port  your  instrument  is  connected  to.");
    layout->addWidget(new QLabel(QStringLiteral("Baud rate"), this));
    cboBaud_ = new QComboBox(this);
    cboBaud_->setObjectName(QStringLiteral("cboBaud"));
    cboBaud_->setEditable(true);
    layout->addWidget(cboBaud_);
    addNote("*   Your  meter  MUST  be  set  to  the  same  baud  rate.");
    addNote("*   Select  the  fastest  baud  rate your  instrument  supports.");
    addNote("*   Select  a  slower  baud  rate  if  you  experience  problems.");
    auto* buttons = new QHBoxLayout;
    auto* ok = new QPushButton(QStringLiteral("&OK"), this);
    auto* cancel = new QPushButton(QStringLiteral("&Cancel"), this);
    ok->setObjectName(QStringLiteral("cmdOK"));
    cancel->setObjectName(QStringLiteral("cmdCancel"));
    ok->setDefault(true);
    ok->setAutoDefault(true);
    buttons->addStretch();
    buttons->addWidget(ok);
    buttons->addWidget(cancel);
    layout->addLayout(buttons);
    connect(ok, &QPushButton::clicked, this, &CommsPortDialog::cmdOK_Click);
    connect(cancel, &QPushButton::clicked, this, &QDialog::reject);

    FillPortList(portName);
    cboBaud_->addItems(speeds());
    cboBaud_->setCurrentText(QString::number(baudRate));
}

void CommsPortDialog::FillPortList(const QString& portName) {
    QStringList ports = PortProbe::existingPorts();
    // A device path the system does not enumerate (a USB adapter under another name, a
    // pseudo-terminal) stays offered when it is the configured one and it exists.
    if (!portName.isEmpty() && !ports.contains(portName) && PortProbe::comPortExists(portName))
        ports.append(portName);
    cboCom_->addItems(ports);
    if (cboCom_->count() > 0)
        cboCom_->setCurrentIndex(0);
    const int stored = cboCom_->findText(portName, Qt::MatchExactly | Qt::MatchCaseSensitive);
    if (stored >= 0)
        cboCom_->setCurrentIndex(stored);
}

void CommsPortDialog::cmdOK_Click() {
    const QString port = cboCom_->currentText().trimmed();
    bool ok = false;
    const qlonglong baud = cboBaud_->currentText().trimmed().toLongLong(&ok);
    if (!ok || baud <= 0 || baud > std::numeric_limits<qint32>::max()) {
        prompts_.show(
            QStringLiteral("The  baud  rate  must  be  a  whole  number,  for  example  9600."),
            Prompts::Icon::Exclamation, Prompts::Buttons::Ok);
        cboBaud_->setFocus();
        return;
    }
    if (!PortNames::isUsableName(port)) {
        prompts_.show(
            QStringLiteral("Please  enter  a  serial  port  name  such  as  COM1  or  ttyUSB0."),
            Prompts::Icon::Exclamation, Prompts::Buttons::Ok);
        cboCom_->setFocus();
        return;
    }
    port_ = port;
    baud_ = static_cast<qint32>(baud);
    accept();
}
