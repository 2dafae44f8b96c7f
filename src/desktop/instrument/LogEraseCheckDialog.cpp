#include "desktop/instrument/LogEraseCheckDialog.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QVBoxLayout>

LogEraseCheckDialog::LogEraseCheckDialog(QWidget* parent) : QDialog(parent) {
    setObjectName(QStringLiteral("frmLogEraseCheck"));
    setWindowTitle(QStringLiteral("Erase Log"));
    setModal(true);

    Label1 = new QLabel(QStringLiteral("Would  you  like  to  erase  logged  data?"), this);
    Label1->setObjectName(QStringLiteral("Label1"));
    cmdOK = new QPushButton(QStringLiteral("&Yes"), this);
    cmdOK->setObjectName(QStringLiteral("cmdOK"));
    cmdOK->setDefault(true);
    cmdCancel = new QPushButton(QStringLiteral("&No"), this);
    cmdCancel->setObjectName(QStringLiteral("cmdCancel"));

    auto* buttons = new QHBoxLayout;
    buttons->addStretch();
    buttons->addWidget(cmdOK);
    buttons->addWidget(cmdCancel);
    buttons->addStretch();
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(Label1);
    layout->addLayout(buttons);

    connect(cmdOK, &QPushButton::clicked, this, &LogEraseCheckDialog::yesClicked);
    // QDialog maps Escape and the title bar's close to reject().
    connect(cmdCancel, &QPushButton::clicked, this, &QDialog::reject);
}
