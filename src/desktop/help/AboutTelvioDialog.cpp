#include "desktop/help/AboutTelvioDialog.h"

#include "core/settings/Version.h"
#include "desktop/help/MakerContact.h"
#include "desktop/help/OkButtonRow.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QVBoxLayout>

AboutTelvioDialog::AboutTelvioDialog(QWidget* parent) : QDialog(parent) {
    setObjectName(QStringLiteral("frmAboutTelvio"));
    setWindowTitle(QStringLiteral("About Telvio"));
    setModal(true);

    auto* name = new QLabel(QStringLiteral("Telvio"), this);
    name->setObjectName(QStringLiteral("Label1"));
    QFont big = name->font();
    big.setPointSizeF(big.pointSizeF() * 1.8);
    big.setBold(true);
    name->setFont(big);
    auto* purpose = new QLabel(
        QStringLiteral("Communications  program  for  KVO  laboratory  and  field  meters"), this);
    purpose->setObjectName(QStringLiteral("Label3"));
    auto* version = new QLabel(versionText(), this);
    version->setObjectName(QStringLiteral("lblVersion"));
    auto* notice = new QLabel(QString::fromUtf8(MakerContact::kNotice), this);
    notice->setObjectName(QStringLiteral("Label2"));

    QHBoxLayout* buttons = okButtonRow(this, QStringLiteral("OK"));

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(name);
    layout->addWidget(purpose);
    layout->addSpacing(8);
    layout->addWidget(version);
    layout->addWidget(notice);
    layout->addSpacing(8);
    layout->addLayout(buttons);
}

QString AboutTelvioDialog::versionText() {
    return QStringLiteral("Version : v%1.%2").arg(telvio::kVersionMajor).arg(telvio::kVersionMinor);
}

#include "moc_AboutTelvioDialog.cpp"
