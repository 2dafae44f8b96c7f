#include "PdfAndDialogChecks.h"
#include "help/AboutKvoDialog.h"
#include "help/AboutTelvioDialog.h"
#include "help/CatalogDialog.h"
#include "help/Catalogue.h"
#include "shell/AppState.h"
#include "support/DialogDriver.h"
#include "support/PromptRecorder.h"
#include "support/ScriptedDialogs.h"

#include <QBuffer>
#include <QComboBox>
#include <QDir>
#include <QFile>
#include <QImage>
#include <QLabel>
#include <QPushButton>
#include <QTemporaryDir>
#include <QtTest>

class AboutTest : public QObject {
    Q_OBJECT
private slots:
    void init();
    void versionText();
    void makerBox();
    void splash_data();
    void splash();
    void emailAndWebOpenThroughSeam();
    void failedOpenIsReported();
    void catalogueLabelOpensChooser();
    void pagePath_data();
    void pagePath();
    void driveText_data();
    void driveText();
    void pageExistsOnlyForAbsoluteFile();
    void chooserSelectsRememberedDrive_data();
    void chooserSelectsRememberedDrive();
    void browseOpensPresentPageAtOnce();
    void browseAbsentRemembersDriveAndSaysNotFound();
    void chooserCancelChangesNothing();
    void shellMetacharactersRunNothing_data();
    void shellMetacharactersRunNothing();

private:
    // Makes <folder>/kvo/index.html and returns the folder.
    static QString makeCatalogue(const QString& folder);

    AppState state_;
    PromptRecorder prompts_;
    ScriptedDialogs dialogs_;
    std::unique_ptr<QTemporaryDir> tmp_;
};

void AboutTest::init() {
    DialogDriver::takeFailures();
    state_ = AppState();
    state_.catalogDrive = QStringLiteral("d:");
    prompts_ = PromptRecorder();
    dialogs_ = ScriptedDialogs();
    tmp_ = std::make_unique<QTemporaryDir>();
    QVERIFY(tmp_->isValid());
}

QString AboutTest::makeCatalogue(const QString& folder) {
    QDir().mkpath(folder + "/kvo");
    QFile page(folder + "/kvo/index.html");
    if (page.open(QIODevice::WriteOnly))
        page.write("<html><body>Catalogue</body></html>");
    return folder;
}

void AboutTest::versionText() {
    QCOMPARE(AboutTelvioDialog::versionText(), QStringLiteral("Version : v1.36"));
    AboutTelvioDialog box;
    QCOMPARE(box.objectName(), QStringLiteral("frmAboutTelvio"));
    QCOMPARE(box.windowTitle(), QStringLiteral("About Telvio"));
    QCOMPARE(box.findChild<QLabel*>("lblVersion")->text(), QStringLiteral("Version : v1.36"));
    const QString notice = box.findChild<QLabel*>("Label2")->text();
    QVERIFY(notice.contains("2026") && notice.contains("KVO"));
    auto* ok = box.findChild<QPushButton*>("cmdOK");
    QCOMPARE(ok->text(), QStringLiteral("OK"));
    box.show();
    ok->click();
    QVERIFY(!box.isVisible());
}

void AboutTest::makerBox() {
    AboutKvoDialog box(state_, prompts_, dialogs_, tmp_->path());
    QCOMPARE(box.objectName(), QStringLiteral("frmAboutKVO"));
    QCOMPARE(box.windowTitle(), QStringLiteral(" About  KVO"));
    const QStringList lines = box.label("Label1")->text().split('\n');
    QCOMPARE(lines.size(), 11);
    for (int i : {0, 1, 2, 3, 6, 7, 9, 10})
        QVERIFY2(!lines.at(i).trimmed().isEmpty(), qPrintable(QString::number(i)));
    for (int i : {4, 5, 8})
        QVERIFY(lines.at(i).isEmpty());
    QVERIFY(lines.at(7).contains('+') && lines.at(10).contains('+')); // international forms
    QCOMPARE(box.label("Text1")->text(), QStringLiteral("Email"));
    QCOMPARE(box.label("Text2")->text(), QStringLiteral("Web  Site"));
    QCOMPARE(box.label("Text3")->text(), QStringLiteral("CD  Catalogue"));
    QCOMPARE(box.label("lblCatalogue")->text(), QDir::toNativeSeparators("d:/kvo/index.html"));
    QVERIFY(box.label("lblEmail")->text().contains('@'));
    QCOMPARE(box.findChild<QPushButton*>("cmdOK")->text(), QStringLiteral("&OK"));
}

void AboutTest::splash_data() {
    QTest::addColumn<QByteArray>("content");
    QTest::addColumn<QSize>("size");
    QImage picture(64, 40, QImage::Format_RGB32);
    picture.fill(Qt::darkCyan);
    QByteArray jpeg;
    QBuffer buffer(&jpeg);
    picture.save(&buffer, "JPG");
    QTest::newRow("present") << jpeg << QSize(64, 40);
    QTest::newRow("missing") << QByteArray() << QSize();
    QTest::newRow("not a picture") << QByteArray("this is not a jpeg") << QSize();
}

void AboutTest::splash() {
    QFETCH(QByteArray, content);
    if (!content.isEmpty()) {
        QFile splash(tmp_->filePath("Splash.jpg"));
        QVERIFY(splash.open(QIODevice::WriteOnly));
        splash.write(content);
    }
    AboutKvoDialog box(state_, prompts_, dialogs_, tmp_->path());
    box.show();
    QFETCH(QSize, size);
    const QPixmap shown = box.label("imgSplash")->pixmap();
    QCOMPARE(shown.isNull(), size.isEmpty());
    if (!shown.isNull())
        QCOMPARE(shown.size(), size);
    QVERIFY(prompts_.shown.isEmpty());
}

void AboutTest::emailAndWebOpenThroughSeam() {
    AboutKvoDialog box(state_, prompts_, dialogs_, tmp_->path());
    box.show();
    QTest::mouseClick(box.label("lblEmail"), Qt::LeftButton);
    QTest::mouseClick(box.label("lblWeb"), Qt::LeftButton);
    QCOMPARE(dialogs_.openedWithDefault.size(), 2);
    QCOMPARE(dialogs_.openedWithDefault.at(0).scheme(), QStringLiteral("mailto"));
    QCOMPARE(dialogs_.openedWithDefault.at(0).path(), box.label("lblEmail")->text());
    QVERIFY(dialogs_.openedWithDefault.at(1).scheme() == QStringLiteral("https"));
    QVERIFY(dialogs_.openedWithDefault.at(1).host().endsWith(box.label("lblWeb")->text().mid(4)));
    QVERIFY(prompts_.shown.isEmpty());
}

void AboutTest::failedOpenIsReported() {
    dialogs_.setOpenWithResult(false);
    AboutKvoDialog box(state_, prompts_, dialogs_, tmp_->path());
    QTest::mouseClick(box.label("lblWeb"), Qt::LeftButton);
    QCOMPARE(prompts_.shown.size(), 1);
    QCOMPARE(prompts_.shown.at(0).icon, Prompts::Icon::Information);
}

void AboutTest::catalogueLabelOpensChooser() {
    const QString cd = makeCatalogue(tmp_->filePath("cd"));
    AboutKvoDialog box(state_, prompts_, dialogs_, tmp_->path());
    box.show();
    DialogDriver::whenModal("frmCatalog", [cd](QWidget* modal) {
        modal->findChild<QComboBox*>("drvCatalogue")->setEditText(cd);
        DialogDriver::click(modal, "cmdOK");
    });
    QTest::mouseClick(box.label("lblCatalogue"), Qt::LeftButton);
    QCOMPARE(DialogDriver::takeFailures(), QStringList());
    QVERIFY(prompts_.shown.isEmpty());
    QCOMPARE(state_.catalogDrive, cd);
    QCOMPARE(dialogs_.openedWithDefault, QList<QUrl>{QUrl::fromLocalFile(cd + "/kvo/index.html")});
    // The label follows the drive now remembered.
    QCOMPARE(box.label("lblCatalogue")->text(), QDir::toNativeSeparators(cd + "/kvo/index.html"));
}

void AboutTest::pagePath_data() {
    QTest::addColumn<QString>("drive");
    QTest::addColumn<QString>("page");
    auto row = [](const char* tag, const char* drive, const char* page) {
        QTest::newRow(tag) << QString(drive) << QString(page);
    };
    row("windows drive", "d:", "d:/kvo/index.html");
    row("drive with separator", "e:\\", "e:/kvo/index.html");
    row("mount path", "/media/cdrom", "/media/cdrom/kvo/index.html");
    row("mount path with slash", "/media/cdrom/", "/media/cdrom/kvo/index.html");
    row("root", "/", "/kvo/index.html");
}

void AboutTest::pagePath() {
    QFETCH(QString, drive);
    QFETCH(QString, page);
    QCOMPARE(Catalogue::pagePath(drive), page);
}

void AboutTest::driveText_data() {
    QTest::addColumn<QString>("root");
    QTest::addColumn<QString>("drive");
    auto row = [](const char* tag, const char* root, const char* drive) {
        QTest::newRow(tag) << QString(root) << QString(drive);
    };
    row("windows root", "C:/", "c:");
    row("windows root, backslash", "D:\\", "d:");
    row("linux root", "/", "/");
    row("mount", "/media/user/KVO CD/", "/media/user/KVO CD");
}

void AboutTest::driveText() {
    QFETCH(QString, root);
    QFETCH(QString, drive);
    QCOMPARE(Catalogue::driveText(root), drive);
}

void AboutTest::pageExistsOnlyForAbsoluteFile() {
    const QString cd = makeCatalogue(tmp_->filePath("cd"));
    QVERIFY(Catalogue::pageExists(cd));
    QVERIFY(!Catalogue::pageExists(tmp_->path()));
    QVERIFY(!Catalogue::pageExists(QString()));
    // A page under a relative drive text is never found, even in the current folder.
    makeCatalogue(tmp_->filePath("rel"));
    const QString before = QDir::currentPath();
    QDir::setCurrent(tmp_->path());
    const bool relative = Catalogue::pageExists(QStringLiteral("rel"));
    QDir::setCurrent(before);
    QVERIFY(!relative);
    // A folder named index.html is not a page.
    QDir().mkpath(tmp_->filePath("odd/kvo/index.html"));
    QVERIFY(!Catalogue::pageExists(tmp_->filePath("odd")));
}

void AboutTest::chooserSelectsRememberedDrive_data() {
    QTest::addColumn<QString>("remembered");
    QTest::addColumn<QString>("selected");
    QTest::newRow("present") << QString("e:") << QString("e:");
    QTest::newRow("letter case ignored") << QString("E:") << QString("e:");
    QTest::newRow("absent keeps the list's own choice") << QString("x:") << QString("c:");
}

void AboutTest::chooserSelectsRememberedDrive() {
    QFETCH(QString, remembered);
    QFETCH(QString, selected);
    state_.catalogDrive = remembered;
    CatalogDialog chooser(state_, prompts_, dialogs_, {"c:", "d:", "e:"});
    QCOMPARE(chooser.objectName(), QStringLiteral("frmCatalog"));
    QCOMPARE(chooser.findChild<QLabel*>("Label1")->text(),
             QStringLiteral("Please  insert  CD  in  drive"));
    QCOMPARE(chooser.driveList()->currentText(), selected);
    QVERIFY(prompts_.shown.isEmpty());
    QCOMPARE(state_.catalogDrive, remembered);
}

void AboutTest::browseOpensPresentPageAtOnce() {
    state_.catalogDrive = makeCatalogue(tmp_->filePath("cd"));
    QVERIFY(noModalDuring([this] { Catalogue::browse(state_, prompts_, dialogs_, nullptr); }));
    QCOMPARE(dialogs_.openedWithDefault,
             QList<QUrl>{QUrl::fromLocalFile(state_.catalogDrive + "/kvo/index.html")});
}

void AboutTest::browseAbsentRemembersDriveAndSaysNotFound() {
    const QString empty = tmp_->filePath("empty");
    QDir().mkpath(empty);
    QStringList offered;
    bool stillOpen = false;
    DialogDriver::whenModal("frmCatalog", [&](QWidget* modal) {
        auto* list = modal->findChild<QComboBox*>("drvCatalogue");
        for (int i = 0; i < list->count(); ++i)
            offered.append(list->itemText(i));
        list->setEditText(empty);
        DialogDriver::click(modal, "cmdOK");
        stillOpen = modal->isVisible();
        DialogDriver::click(modal, "cmdCancel");
    });
    Catalogue::browse(state_, prompts_, dialogs_, nullptr);
    QCOMPARE(DialogDriver::takeFailures(), QStringList());
    QVERIFY(offered.contains(Catalogue::defaultDrive()));
    QVERIFY(stillOpen);
    QCOMPARE(prompts_.texts(), QStringList{QStringLiteral("Catalogue  not  found.")});
    QCOMPARE(prompts_.shown.at(0).icon, Prompts::Icon::Exclamation);
    QCOMPARE(state_.catalogDrive, empty); // kept although the page is missing
    QVERIFY(dialogs_.openedWithDefault.isEmpty());
}

void AboutTest::chooserCancelChangesNothing() {
    DialogDriver::whenModal("frmCatalog", [](QWidget* modal) {
        modal->findChild<QComboBox*>("drvCatalogue")->setEditText("/somewhere/else");
        DialogDriver::click(modal, "cmdCancel");
    });
    Catalogue::browse(state_, prompts_, dialogs_, nullptr);
    QCOMPARE(DialogDriver::takeFailures(), QStringList());
    QCOMPARE(state_.catalogDrive, QStringLiteral("d:"));
    QVERIFY(prompts_.shown.isEmpty());
    QVERIFY(dialogs_.openedWithDefault.isEmpty());
}

void AboutTest::shellMetacharactersRunNothing_data() {
    QTest::addColumn<QString>("name");
    QTest::addColumn<bool>("present");
    const QString nasty =
        "cd; touch PWNED1 && $(touch PWNED2) `touch PWNED3` | tee PWNED4 & > PWNED5";
    QTest::newRow("page present") << nasty << true;
    QTest::newRow("page absent") << nasty << false;
    QTest::newRow("windows style") << "d: & start calc.exe & echo" << false;
}

// A drive text is only ever a path: it is handed over as a file address, and nothing runs.
void AboutTest::shellMetacharactersRunNothing() {
    QFETCH(QString, name);
    QFETCH(bool, present);
    const QString before = QDir::currentPath();
    QDir::setCurrent(tmp_->path());
    const QString drive = present ? makeCatalogue(tmp_->filePath(name)) : name;
    state_.catalogDrive = drive;
    QString seen;
    DialogDriver::whenModal(
        QString(),
        [&seen](QWidget* modal) {
            seen = modal->objectName();
            modal->close();
        },
        500);
    Catalogue::browse(state_, prompts_, dialogs_, nullptr);
    QTest::qWait(600);
    DialogDriver::takeFailures(); // "no dialog" is what the present page should give
    QDir::setCurrent(before);

    if (present) {
        QCOMPARE(dialogs_.openedWithDefault.size(), 1);
        const QUrl url = dialogs_.openedWithDefault.at(0);
        QVERIFY(url.isLocalFile());
        QCOMPARE(url.toLocalFile(), drive + "/kvo/index.html");
        QCOMPARE(seen, QString());
    } else {
        QVERIFY(dialogs_.openedWithDefault.isEmpty());
        QCOMPARE(seen, QStringLiteral("frmCatalog")); // closing it changed nothing
        QCOMPARE(state_.catalogDrive, drive);
    }
    const QStringList made = QDir(tmp_->path()).entryList({"PWNED*", "*calc*"});
    QVERIFY2(made.isEmpty(), qPrintable(made.join(',')));
    QVERIFY(QDir(QDir::tempPath()).entryList({"PWNED*"}).isEmpty());
}

QTEST_MAIN(AboutTest)
#include "About_test.moc"
