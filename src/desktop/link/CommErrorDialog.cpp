#include "desktop/link/CommErrorDialog.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QVBoxLayout>

CommErrorDialog::CommErrorDialog(QWidget* parent) : QDialog(parent) {
    setObjectName(QStringLiteral("frmCommError"));
    setWindowTitle(QString());
    setModal(true);
    auto* layout = new QVBoxLayout(this);
    const char* texts[] = {
        "A  serial port  error  was  encountered.     It  may  have  been  caused  by  the  "
        "following ...",
        "-   A  foreign   device  attached  to  the  communications  port.",
        "-   Incorrect  serial  port  settings.",
        "-  Dislodged  serial  cable.",
    };
    for (const char* t : texts) {
        auto* label = new QLabel(QString::fromLatin1(t), this);
        label->setWordWrap(true);
        layout->addWidget(label);
    }
    auto* buttons = new QHBoxLayout;
    auto* setup = new QPushButton(QStringLiteral("&Setup"), this);
    auto* retry = new QPushButton(QStringLiteral("&Retry "), this);
    auto* cancel = new QPushButton(QStringLiteral("&Cancel "), this);
    setup->setObjectName(QStringLiteral("cmdSetup"));
    retry->setObjectName(QStringLiteral("cmdRetry"));
    cancel->setObjectName(QStringLiteral("cmdCancel"));
    setup->setDefault(true);
    for (QPushButton* b : {setup, retry, cancel})
        buttons->addWidget(b);
    layout->addLayout(buttons);
    connect(setup, &QPushButton::clicked, this, [this] {
        choice_ = Choice::Setup;
        accept();
    });
    connect(retry, &QPushButton::clicked, this, [this] {
        choice_ = Choice::Retry;
        accept();
    });
    // Escape rejects the dialog, which keeps the Cancel choice.
    connect(cancel, &QPushButton::clicked, this, [this] {
        choice_ = Choice::Cancel;
        reject();
    });
}
