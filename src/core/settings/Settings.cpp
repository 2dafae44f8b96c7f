#include "core/settings/Settings.h"

#include "core/Prompts.h"
#include "core/settings/AppState.h"

#include <QCoreApplication>
#include <QDateTime>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QLocale>
#include <QSettings>
#include <cmath>
#include <limits>
#include <stdexcept>

namespace {

constexpr const char* kOrganization = "Telvio";
constexpr const char* kApplication = "Telvio";
constexpr const char* kSection = "Settings";

class ConversionError : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

// Numbers are read like the platform reads a number typed by the user: surrounding blanks are
// allowed, a fraction is rounded for whole-number fields, anything else fails.
double toNumber(const QString& text) {
    const QString t = text.trimmed();
    bool ok = false;
    double v = QLocale::c().toDouble(t, &ok);
    if (!ok)
        v = QLocale::system().toDouble(t, &ok);
    if (!ok || !std::isfinite(v))
        throw ConversionError("not a number");
    return v;
}

template <typename Int> Int toWhole(const QString& text) {
    const double v = std::nearbyint(toNumber(text));
    if (v < double(std::numeric_limits<Int>::min()) || v > double(std::numeric_limits<Int>::max()))
        throw ConversionError("out of range");
    return static_cast<Int>(v);
}

QString readText(QSettings& store, const char* key, const char* fallback) {
    const QVariant v = store.value(key, QString::fromLatin1(fallback));
    if (!v.canConvert<QString>())
        throw ConversionError("not text");
    return v.toString();
}

QString numberText(double v) {
    return QString::number(v, 'g', QLocale::FloatingPointShortest);
}

// Renames a settings file that cannot be parsed to "<name>.broken-<date>-<time>" in its own
// folder. Returns the new path, or "" when it could not be moved.
QString moveAside(const QString& path) {
    const QString stamp = QDateTime::currentDateTime().toString(QStringLiteral("yyyyMMdd-hhmmss"));
    QString target = path + QStringLiteral(".broken-") + stamp;
    for (int n = 2; QFileInfo::exists(target); ++n)
        target = path + QStringLiteral(".broken-") + stamp + QLatin1Char('-') + QString::number(n);
    return QFile::rename(path, target) ? target : QString();
}

// Writes the seven settings in their fixed order; returns the store's status afterwards.
QSettings::Status writeAll(const AppState& state, QString* fileName) {
    QSettings store(kOrganization, kApplication);
    *fileName = store.fileName();
    store.beginGroup(kSection);
    store.setValue("COM", state.portName);
    store.setValue("Baud", QString::number(state.baudRate));
    store.setValue("LogInvterval", numberText(state.logInterval));
    store.setValue("Asterisk", QString::number(state.convertAsterisks));
    store.setValue("mS", QString::number(state.convertMsToUs));
    store.setValue("ppK", QString::number(state.convertPpkToPpm));
    store.setValue("Drive", state.catalogDrive);
    store.endGroup();
    store.sync();
    return store.status();
}

QString executableBaseName() {
    const QString base = QFileInfo(QCoreApplication::applicationFilePath()).completeBaseName();
    return base.isEmpty() ? QString::fromLatin1(kApplication) : base;
}

} // namespace

namespace Settings {

void SetPortName(AppState& state, const QString& name) {
    state.portName = name;
    state.portDevicePath = QStringLiteral("\\\\.\\") + name;
}

bool LoadSettings(AppState& state, Prompts& prompts, bool* firstRun) {
    if (firstRun)
        *firstRun = false;
    try {
        QSettings store(kOrganization, kApplication);
        store.beginGroup(kSection);
        SetPortName(state, readText(store, "COM", "COM1"));
        state.baudRate = toWhole<qint32>(readText(store, "Baud", "9600"));
        state.logInterval = toNumber(readText(store, "LogInvterval", "1"));
        state.convertAsterisks = toWhole<qint16>(readText(store, "Asterisk", "0"));
        state.convertMsToUs = toWhole<qint16>(readText(store, "mS", "0"));
        state.convertPpkToPpm = toWhole<qint16>(readText(store, "ppK", "0"));
        state.catalogDrive = readText(store, "Drive", "d:");
        // A file that cannot be parsed still gives what could be read, and the defaults for the
        // rest; the next save moves it aside and writes a fresh one.
        if (store.status() == QSettings::FormatError) {
            state.settingsFileBroken = true;
            throw ConversionError("settings file cannot be parsed");
        }
        // Asking marks the first start done, so only a caller that runs the wizard asks.
        if (firstRun)
            *firstRun = IsFirstRun();
    } catch (const std::exception&) {
        prompts.show(QString::fromLatin1(kRetrieveError), Prompts::Icon::Information,
                     Prompts::Buttons::Ok);
        return false;
    }
    return true;
}

bool SaveSettings(AppState& state, Prompts& prompts) {
    // A file that cannot be parsed is kept under another name in the same folder, and a fresh
    // one is written in its place. Qt reports the fault only to the first reader of the file, so
    // the load's finding counts as well as the status of this write.
    QString brokenFile;
    if (state.settingsFileBroken) {
        state.settingsFileBroken = false;
        brokenFile = moveAside(QSettings(kOrganization, kApplication).fileName());
    }
    QString fileName;
    QSettings::Status status = writeAll(state, &fileName);
    if (status == QSettings::FormatError && brokenFile.isEmpty()) {
        brokenFile = moveAside(fileName);
        if (!brokenFile.isEmpty())
            status = writeAll(state, &fileName);
    }
    if (status != QSettings::NoError) {
        prompts.show(QString::fromLatin1(kSaveError), Prompts::Icon::Information,
                     Prompts::Buttons::Ok);
        return false;
    }
    if (!brokenFile.isEmpty())
        prompts.show(
            QStringLiteral("The settings file could not be read. It has been kept as\r\n") +
                QDir::toNativeSeparators(brokenFile) +
                QStringLiteral("\r\nand the settings have been saved in a new file."),
            Prompts::Icon::Information, Prompts::Buttons::Ok);
    return true;
}

bool IsFirstRun() {
    const QString app = executableBaseName();
    QSettings store(QString::fromLatin1(kOrganization), app);
    store.beginGroup(kSection);
    const QString text = store.value("FirstRun", QStringLiteral("True")).toString().trimmed();
    bool first = false;
    if (text.compare(QLatin1String("true"), Qt::CaseInsensitive) == 0)
        first = true;
    else if (text.compare(QLatin1String("false"), Qt::CaseInsensitive) == 0)
        first = false;
    else
        first = toNumber(text) != 0; // a number counts as a boolean, like the platform's conversion
    if (first)
        store.setValue("FirstRun", QStringLiteral("False"));
    return first;
}

QString EnsureDataFolder(const QString& documentsFolder) {
    const QString folder = QDir(documentsFolder).filePath(QStringLiteral("Telvio"));
    QDir().mkpath(folder); // failures are ignored: start-up goes on without the folder
    return folder;
}

bool FileExists(const QString& path) {
    const QFileInfo info(path);
    return info.exists() && info.isFile();
}

} // namespace Settings
