#include "desktop/link/CpuOverUseDialog.h"

#include <QLabel>
#include <QPushButton>
#include <QVBoxLayout>

CpuOverUseDialog::CpuOverUseDialog(QWidget* parent) : QDialog(parent) {
    setObjectName(QStringLiteral("frmCPUOverUse"));
    setWindowTitle(QStringLiteral("  Error"));
    setModal(true);
    auto* layout = new QVBoxLayout(this);
    const char* texts[] = {
        "An  error  has  ocurred.    Your  computer  or  meter  may  be  busy  with  other  "
        "processes,  and  unable  to  maintain data  logging  functions.    Consider  the  "
        "following  solutions ...",
        "-  Check that your meter is running in normal display mode.",
        "-  Close all unnecessary running programs on your computer.",
        "-  Increase time between meter readings.",
        "-  Close Telvio.  Turn off your meter, then turn it back on.  Restart Telvio.",
    };
    for (const char* t : texts) {
        auto* label = new QLabel(QString::fromLatin1(t), this);
        label->setWordWrap(true);
        layout->addWidget(label);
    }
    auto* exit = new QPushButton(QStringLiteral("E&xit  Current  Data  Logging"), this);
    exit->setObjectName(QStringLiteral("Command1"));
    exit->setDefault(true);
    layout->addWidget(exit);
    connect(exit, &QPushButton::clicked, this, &QDialog::accept);
}
