#include "desktop/readings/RealTimeIntervalDialog.h"

#include "core/Prompts.h"
#include "core/readings/IntervalRule.h"
#include "desktop/shell/MainWindow.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QVBoxLayout>

RealTimeIntervalDialog::RealTimeIntervalDialog(MainWindow& window) : QDialog(&window), w_(window) {
    setObjectName(QStringLiteral("frmRealTimeInterval"));
    setWindowTitle(QString());
    setModal(true);

    Label1 = new QLabel(QStringLiteral("Please  enter  desired  log  interval  (seconds)"), this);
    Label1->setObjectName(QStringLiteral("Label1"));
    txtLogInterval = new QLineEdit(QString::number(window.state().logInterval), this);
    txtLogInterval->setObjectName(QStringLiteral("txtLogInterval"));
    cmdOK = new QPushButton(QStringLiteral("&OK"), this);
    cmdOK->setObjectName(QStringLiteral("cmdOK"));
    cmdOK->setDefault(true);
    cmdCancel = new QPushButton(QStringLiteral("&Cancel"), this);
    cmdCancel->setObjectName(QStringLiteral("cmdCancel"));

    auto* buttons = new QHBoxLayout;
    buttons->addStretch();
    buttons->addWidget(cmdOK);
    buttons->addWidget(cmdCancel);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(Label1);
    layout->addWidget(txtLogInterval);
    layout->addLayout(buttons);

    connect(cmdOK, &QPushButton::clicked, this, &RealTimeIntervalDialog::ProcessUserInput);
    connect(cmdCancel, &QPushButton::clicked, this, &QDialog::reject);
}

void RealTimeIntervalDialog::showEvent(QShowEvent* event) {
    QDialog::showEvent(event);
    SelectIntervalText();
}

void RealTimeIntervalDialog::SelectIntervalText() {
    txtLogInterval->selectAll();
    txtLogInterval->setFocus();
}

void RealTimeIntervalDialog::ProcessUserInput() {
    const AppState& s = w_.state();
    const IntervalRule::Result r =
        IntervalRule::check(txtLogInterval->text(), s.baudRate, s.modelCode);
    if (!r.accepted) {
        w_.prompts().show(r.message, Prompts::Icon::Exclamation, Prompts::Buttons::Ok);
        SelectIntervalText();
        return;
    }
    seconds_ = r.seconds;
    accept();
}
