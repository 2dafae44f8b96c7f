// The per-user settings as a user, another program or a damaged disk may leave them: garbage
// in the settings file, or values of the wrong type, very long or not numbers at all.
#include "core/settings/Settings.h"
#include "FuzzInput.h"
#include "core/Prompts.h"
#include "core/settings/AppState.h"

#include <QCoreApplication>
#include <QDir>
#include <QFile>
#include <QSettings>
#include <QTemporaryDir>
#include <QVariant>

namespace {

class CountingPrompts : public Prompts {
public:
    Answer show(const QString& text, Icon, Buttons, bool) override {
        texts.append(text);
        return Answer::Ok;
    }
    QStringList texts;
};

QVariant typedValue(uint8_t type, const QByteArray& bytes) {
    const QString text = QString::fromLatin1(bytes);
    switch (type % 5) {
    case 0:
        return text;
    case 1:
        return text.toLongLong();
    case 2:
        return QStringList{text, text.left(2)};
    case 3:
        return !bytes.isEmpty();
    default:
        return text.repeated(1 + bytes.size() % 64); // very long values
    }
}

QString summary(const AppState& s) {
    return QStringList{s.portName,
                       s.portDevicePath,
                       QString::number(s.baudRate),
                       QString::number(s.logInterval, 'g', 17),
                       QString::number(s.convertAsterisks),
                       QString::number(s.convertMsToUs),
                       QString::number(s.convertPpkToPpm),
                       s.catalogDrive}
        .join(u'|');
}

// Saving syncs to disk; in /dev/shm that costs nothing, so many more inputs run.
QTemporaryDir folder(QStringLiteral("/dev/shm/telvio-fuzz-XXXXXX"));
int runNumber = 0;

} // namespace

extern "C" int LLVMFuzzerInitialize(int* argc, char*** argv) {
    static QCoreApplication app(*argc, *argv);
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    FuzzInput in(data, size);
    // A fresh folder each time: the settings store caches files by name.
    const QString dir = (folder.isValid() ? folder.path() : QDir::tempPath()) +
                        QStringLiteral("/run") + QString::number(++runNumber);
    QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, dir);
    QDir().mkpath(dir + QStringLiteral("/Telvio"));
    if (in.takeByte() & 1) {
        QFile file(dir + QStringLiteral("/Telvio/Telvio.conf"));
        if (file.open(QIODevice::WriteOnly))
            file.write(in.rest());
    } else {
        QSettings store(QStringLiteral("Telvio"), QStringLiteral("Telvio"));
        store.beginGroup(QStringLiteral("Settings"));
        for (const char* key : {"COM", "Baud", "LogInvterval", "Asterisk", "mS", "ppK", "Drive"})
            if (const uint8_t type = in.takeByte(); type != 0xff)
                store.setValue(key, typedValue(type, in.takePart()));
    }

    // A failure is reported once, with the fixed message; success shows nothing.
    AppState first;
    CountingPrompts prompts;
    const bool loaded = Settings::LoadSettings(first, prompts);
    const QStringList expected =
        loaded ? QStringList() : QStringList{QString::fromLatin1(Settings::kRetrieveError)};
    FUZZ_CHECK(prompts.texts == expected, prompts.texts.join(u'\n'));

    // Whatever was there, what was loaded can be saved (a broken file is moved aside, never
    // lost) and reads back unchanged.
    prompts.texts.clear();
    FUZZ_CHECK(Settings::SaveSettings(first, prompts), prompts.texts.join(u'\n'));
    AppState second;
    FUZZ_CHECK(Settings::LoadSettings(second, prompts), prompts.texts.join(u'\n'));
    FUZZ_CHECK(summary(first) == summary(second), summary(first) + u'\n' + summary(second));
    QDir(dir).removeRecursively();
    return 0;
}
