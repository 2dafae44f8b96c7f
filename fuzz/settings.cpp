// The per-user settings as a user, another program or a damaged disk may leave them: garbage
// in the settings file, or values of the wrong type, very long or not numbers at all.
#include "shell/Settings.h"
#include "FuzzInput.h"
#include "shell/AppState.h"
#include "shell/Prompts.h"

#include <QCoreApplication>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QSettings>
#include <QTemporaryDir>
#include <QVariant>
#include <cstdlib>

namespace {

class CountingPrompts : public Prompts {
public:
    Answer show(const QString& text, Icon, Buttons, bool) override {
        texts.append(text);
        return Answer::Ok;
    }
    QStringList texts;
};

const char* const kKeys[] = {"COM", "Baud", "LogInvterval", "Asterisk", "mS", "ppK", "Drive"};

QTemporaryDir* folder = nullptr;
int runNumber = 0;

QVariant typedValue(uint8_t type, const QByteArray& bytes) {
    const QString text = QString::fromLatin1(bytes);
    switch (type % 7) {
    case 0:
        return text;
    case 1:
        return bytes;
    case 2:
        return text.toLongLong();
    case 3:
        return QStringList{text, text.left(2)};
    case 4:
        return QVariantMap{{QStringLiteral("k"), text}};
    case 5:
        return !bytes.isEmpty();
    default:
        return text.repeated(1 + bytes.size() % 64); // very long values
    }
}

bool sameSettings(const AppState& a, const AppState& b) {
    return a.portName == b.portName && a.portDevicePath == b.portDevicePath &&
           a.baudRate == b.baudRate && a.logInterval == b.logInterval &&
           a.convertAsterisks == b.convertAsterisks && a.convertMsToUs == b.convertMsToUs &&
           a.convertPpkToPpm == b.convertPpkToPpm && a.catalogDrive == b.catalogDrive;
}

} // namespace

extern "C" int LLVMFuzzerInitialize(int* argc, char*** argv) {
    static QCoreApplication app(*argc, *argv);
    // Saving syncs the file to disk; in memory that costs nothing, so many more inputs run.
    const QString shm = QStringLiteral("/dev/shm");
    folder = QFileInfo(shm).isWritable()
                 ? new QTemporaryDir(shm + QStringLiteral("/telvio-fuzz-XXXXXX"))
                 : new QTemporaryDir;
    std::atexit([] { delete folder; });
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    FuzzInput in(data, size);
    // A fresh folder each time: the settings store caches files by name.
    const QString dir = folder->filePath(QString::number(++runNumber));
    QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, dir);
    QDir().mkpath(dir + QStringLiteral("/Telvio"));

    if (in.takeByte() & 1) {
        QFile file(dir + QStringLiteral("/Telvio/Telvio.conf"));
        if (file.open(QIODevice::WriteOnly))
            file.write(in.rest());
    } else {
        QSettings store(QStringLiteral("Telvio"), QStringLiteral("Telvio"));
        store.beginGroup(QStringLiteral("Settings"));
        for (const char* key : kKeys) {
            const uint8_t type = in.takeByte();
            if (type != 0xff)
                store.setValue(key, typedValue(type, in.takePart()));
        }
    }

    AppState first;
    CountingPrompts prompts;
    const bool loaded = Settings::LoadSettings(first, prompts);
    // A failure is reported once, with the fixed message; success shows nothing.
    if (loaded)
        FUZZ_CHECK(prompts.texts.isEmpty(), prompts.texts.join(u'\n'));
    else
        FUZZ_CHECK(prompts.texts == QStringList{QString::fromLatin1(Settings::kRetrieveError)},
                   prompts.texts.join(u'\n'));

    if (loaded) {
        // What was read is written back and read again unchanged. A file the store cannot
        // parse is not overwritten: saving then reports its one message instead.
        prompts.texts.clear();
        if (!Settings::SaveSettings(first, prompts)) {
            FUZZ_CHECK(prompts.texts == QStringList{QString::fromLatin1(Settings::kSaveError)},
                       prompts.texts.join(u'\n'));
        } else {
            AppState second;
            FUZZ_CHECK(Settings::LoadSettings(second, prompts), prompts.texts.join(u'\n'));
            FUZZ_CHECK(sameSettings(first, second),
                       first.portName + QLatin1Char('|') +
                           QString::number(first.logInterval, 'g', 17) + QLatin1Char('|') +
                           second.portName + QLatin1Char('|') +
                           QString::number(second.logInterval, 'g', 17));
        }
    }
    QDir(dir).removeRecursively();
    return 0;
}
