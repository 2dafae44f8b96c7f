#include "desktop/help/AboutKvoDialog.h"

#include "core/settings/AppState.h"
#include "desktop/help/CatalogDialog.h"
#include "desktop/help/Catalogue.h"
#include "desktop/help/MakerContact.h"
#include "desktop/help/OkButtonRow.h"

#include <QDir>
#include <QEvent>
#include <QFileInfo>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QMouseEvent>
#include <QPushButton>
#include <QStringList>
#include <QUrl>
#include <QVBoxLayout>

namespace {

QString contactBlock() {
    using namespace MakerContact;
    return QStringList{QString::fromUtf8(kCompany),
                       QString::fromUtf8(kStreet),
                       QString::fromUtf8(kSuburbCity),
                       QString::fromUtf8(kCountryPostcode),
                       QString(),
                       QString(),
                       QString::fromUtf8(kPhoneNational),
                       QString::fromUtf8(kPhoneInternational),
                       QString(),
                       QString::fromUtf8(kFaxNational),
                       QString::fromUtf8(kFaxInternational)}
        .join(QLatin1Char('\n'));
}

QLabel* caption(const QString& name, const QString& text, QWidget* parent) {
    auto* label = new QLabel(text, parent);
    label->setObjectName(name);
    QFont bold = label->font();
    bold.setBold(true);
    label->setFont(bold);
    return label;
}

} // namespace

AboutKvoDialog::AboutKvoDialog(AppState& state, Prompts& prompts, PlatformDialogs& dialogs,
                               const QString& folder, QWidget* parent)
    : QDialog(parent), state_(state), prompts_(prompts), dialogs_(dialogs) {
    setObjectName(QStringLiteral("frmAboutKVO"));
    setWindowTitle(QStringLiteral(" About  KVO"));
    setModal(true);

    splash_ = new QLabel(this);
    splash_->setObjectName(QStringLiteral("imgSplash"));
    splash_->setAlignment(Qt::AlignCenter);
    loadSplash(folder);

    auto* contact = new QLabel(contactBlock(), this);
    contact->setObjectName(QStringLiteral("Label1"));
    contact->setTextFormat(Qt::PlainText);
    contact->setTextInteractionFlags(Qt::TextSelectableByMouse);

    email_ = addLink(QStringLiteral("lblEmail"), QString::fromUtf8(MakerContact::kEmail));
    web_ = addLink(QStringLiteral("lblWeb"), QString::fromUtf8(MakerContact::kWebShown));
    catalogue_ = addLink(QStringLiteral("lblCatalogue"), Catalogue::shownPath(state_.catalogDrive));

    auto* links = new QGridLayout;
    links->addWidget(caption(QStringLiteral("Text1"), QStringLiteral("Email"), this), 0, 0);
    links->addWidget(email_, 0, 1);
    links->addWidget(caption(QStringLiteral("Text2"), QStringLiteral("Web  Site"), this), 1, 0);
    links->addWidget(web_, 1, 1);
    links->addWidget(caption(QStringLiteral("Text3"), QStringLiteral("CD  Catalogue"), this), 2, 0);
    links->addWidget(catalogue_, 2, 1);
    links->setColumnStretch(1, 1);

    QHBoxLayout* buttons = okButtonRow(this, QStringLiteral("&OK"));

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(splash_);
    layout->addWidget(contact);
    layout->addSpacing(8);
    layout->addLayout(links);
    layout->addLayout(buttons);
}

QLabel* AboutKvoDialog::label(const char* name) const {
    return findChild<QLabel*>(QString::fromLatin1(name));
}

QLabel* AboutKvoDialog::addLink(const QString& name, const QString& text) {
    auto* label = new QLabel(text, this);
    label->setObjectName(name);
    label->setTextFormat(Qt::PlainText);
    label->setCursor(Qt::PointingHandCursor);
    QFont underlined = label->font();
    underlined.setUnderline(true);
    label->setFont(underlined);
    QPalette blue = label->palette();
    blue.setColor(QPalette::WindowText, QColor(0, 0, 192));
    label->setPalette(blue);
    label->installEventFilter(this);
    return label;
}

void AboutKvoDialog::loadSplash(const QString& folder) {
    // The picture is optional: without it, or if it cannot be read, the box simply has none.
    const QString path = QDir(folder).filePath(QStringLiteral("Splash.jpg"));
    if (!QFileInfo(path).isFile())
        return;
    QPixmap picture(path);
    if (picture.isNull())
        return;
    if (picture.width() > 480 || picture.height() > 320)
        picture = picture.scaled(480, 320, Qt::KeepAspectRatio, Qt::SmoothTransformation);
    splash_->setPixmap(picture);
}

void AboutKvoDialog::lblCatalogue_Click() {
    CatalogDialog chooser(state_, prompts_, dialogs_, Catalogue::availableDrives(), this);
    chooser.exec();
    catalogue_->setText(Catalogue::shownPath(state_.catalogDrive));
}

bool AboutKvoDialog::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() == QEvent::MouseButtonPress &&
        static_cast<QMouseEvent*>(event)->button() == Qt::LeftButton) {
        if (watched == email_) {
            QUrl mail;
            mail.setScheme(QStringLiteral("mailto"));
            mail.setPath(QString::fromUtf8(MakerContact::kEmail));
            Catalogue::open(mail, prompts_, dialogs_);
            return true;
        }
        if (watched == web_) {
            Catalogue::open(QUrl(QString::fromUtf8(MakerContact::kWebUrl)), prompts_, dialogs_);
            return true;
        }
        if (watched == catalogue_) {
            lblCatalogue_Click();
            return true;
        }
    }
    return QDialog::eventFilter(watched, event);
}

#include "moc_AboutKvoDialog.cpp"
