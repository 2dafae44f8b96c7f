#include "desktop/help/CatalogDialog.h"

#include "core/Prompts.h"
#include "core/settings/AppState.h"
#include "desktop/help/Catalogue.h"

#include <QComboBox>
#include <QDir>
#include <QFileInfo>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QRegularExpression>
#include <QUrl>
#include <QVBoxLayout>

CatalogDialog::CatalogDialog(AppState& state, Prompts& prompts, PlatformDialogs& dialogs,
                             const QStringList& drives, QWidget* parent)
    : QDialog(parent), state_(state), prompts_(prompts), dialogs_(dialogs) {
    setObjectName(QStringLiteral("frmCatalog"));
    setWindowTitle(QStringLiteral("  Catalogue"));
    setModal(true);

    auto* label = new QLabel(QStringLiteral("Please  insert  CD  in  drive"), this);
    label->setObjectName(QStringLiteral("Label1"));
    drives_ = new QComboBox(this);
    drives_->setObjectName(QStringLiteral("drvCatalogue"));
    // A drive may also be typed: elsewhere than on Windows it is any folder or mount path.
    drives_->setEditable(true);
    drives_->setInsertPolicy(QComboBox::NoInsert);
    drives_->setMinimumWidth(260);
    auto* ok = new QPushButton(QStringLiteral("&OK"), this);
    ok->setObjectName(QStringLiteral("cmdOK"));
    ok->setDefault(true);
    auto* cancel = new QPushButton(QStringLiteral("&Cancel"), this);
    cancel->setObjectName(QStringLiteral("cmdCancel"));
    connect(ok, &QPushButton::clicked, this, &CatalogDialog::cmdOK_Click);
    connect(cancel, &QPushButton::clicked, this, &QDialog::reject);

    auto* buttons = new QHBoxLayout;
    buttons->addStretch(1);
    buttons->addWidget(ok);
    buttons->addWidget(cancel);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(label);
    layout->addWidget(drives_);
    layout->addLayout(buttons);

    selectInitialDrive(drives);
}

void CatalogDialog::selectInitialDrive(const QStringList& drives) {
    drives_->addItems(drives);
    const QString wanted = state_.catalogDrive;
    // Drive letters ignore case, as the platform does; paths do not.
    int index = drives_->findText(wanted, Qt::MatchFixedString | Qt::MatchCaseSensitive);
    if (index < 0 && QRegularExpression(QStringLiteral("^[A-Za-z]:$")).match(wanted).hasMatch())
        index = drives_->findText(wanted, Qt::MatchFixedString);
    if (index < 0 && QDir::isAbsolutePath(wanted) && QFileInfo(wanted).isDir()) {
        // A folder path that exists is a drive here, though it is not a mount point of its own.
        drives_->addItem(wanted);
        index = drives_->count() - 1;
    }
    if (index < 0)
        index = drives_->findText(Catalogue::defaultDrive(), Qt::MatchFixedString);
    drives_->setCurrentIndex(index < 0 ? 0 : index);
}

void CatalogDialog::cmdOK_Click() {
    const QString drive = drives_->currentText().trimmed();
    // The choice is remembered even when the page is not there.
    state_.catalogDrive = drive;
    if (!Catalogue::pageExists(drive)) {
        prompts_.show(QStringLiteral("Catalogue  not  found."), Prompts::Icon::Exclamation,
                      Prompts::Buttons::Ok);
        return;
    }
    accept();
    Catalogue::open(QUrl::fromLocalFile(Catalogue::pagePath(drive)), prompts_, dialogs_);
}

#include "moc_CatalogDialog.cpp"
