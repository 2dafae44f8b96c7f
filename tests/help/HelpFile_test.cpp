#include "help/HelpFile.h"

#include <QFile>
#include <QRegularExpression>
#include <QTemporaryDir>
#include <QtTest>

Q_DECLARE_METATYPE(HelpKind)

class HelpFileTest : public QObject {
    Q_OBJECT
private slots:
    void parseBlocks_data();
    void parseBlocks();
    void decode_data();
    void decode();
    void loadReadsNamedFileFromFolder();
    void missingFileGivesEmptyTopics();
    void composePrintText();
    void shippedFiles_data();
    void shippedFiles();
};

static const QString CRLF = QStringLiteral("\r\n");

void HelpFileTest::parseBlocks_data() {
    QTest::addColumn<QString>("text");
    QTest::addColumn<int>("count");
    QTest::addColumn<QStringList>("expected");

    QTest::newRow("two blocks, CR LF")
        << "Title A\r\nline\r\n#\r\nTitle B\r\n#\r\n"
        << 2 << QStringList{"Title A" + CRLF + "line" + CRLF, "Title B" + CRLF};
    QTest::newRow("LF endings read the same")
        << "Title A\nline\n#\nTitle B\n#\n"
        << 2 << QStringList{"Title A" + CRLF + "line" + CRLF, "Title B" + CRLF};
    QTest::newRow("lone CR endings") << "A\r#\rB\r#\r" << 2 << QStringList{"A" + CRLF, "B" + CRLF};
    QTest::newRow("empty lines kept")
        << "Title\n\nText\n\n\n#\n"
        << 1 << QStringList{"Title" + CRLF + CRLF + "Text" + CRLF + CRLF + CRLF};
    QTest::newRow("empty block") << "#\nB\n#\n" << 2 << QStringList{QString(), "B" + CRLF};
    QTest::newRow("only a lone # ends a block")
        << "A\n#x\n #\n# \n#\n"
        << 1 << QStringList{"A" + CRLF + "#x" + CRLF + " #" + CRLF + "# " + CRLF};
    QTest::newRow("no line break after the last #") << "A\n#" << 1 << QStringList{"A" + CRLF};
    QTest::newRow("too few blocks") << "A\n#\n"
                                    << 3 << QStringList{"A" + CRLF, QString(), QString()};
    QTest::newRow("unterminated last block keeps its text")
        << "A\n#\nB\nC" << 3 << QStringList{"A" + CRLF, "B" + CRLF + "C" + CRLF, QString()};
    QTest::newRow("text after the last block ignored") << "A\n#\nB\n#\nextra\n#\nmore\n"
                                                       << 2 << QStringList{"A" + CRLF, "B" + CRLF};
    QTest::newRow("empty text") << "" << 2 << QStringList{QString(), QString()};
    QTest::newRow("no topics wanted") << "A\n#\n" << 0 << QStringList{};
}

void HelpFileTest::parseBlocks() {
    QFETCH(QString, text);
    QFETCH(int, count);
    QFETCH(QStringList, expected);
    QCOMPARE(HelpFile::parseBlocks(text, count), expected);
}

void HelpFileTest::decode_data() {
    QTest::addColumn<QByteArray>("bytes");
    QTest::addColumn<QString>("expected");
    QTest::newRow("ascii") << QByteArray("Help\r\n") << QStringLiteral("Help\r\n");
    QTest::newRow("utf-8") << QByteArray("25 \xC2\xB0"
                                         "C")
                           << QString::fromUtf8("25 \u00B0C");
    QTest::newRow("latin-1") << QByteArray("25 \xB0"
                                           "C")
                             << QString::fromUtf8("25 \u00B0C");
    QTest::newRow("byte order mark dropped")
        << QByteArray("\xEF\xBB\xBFHelp") << QStringLiteral("Help");
}

void HelpFileTest::decode() {
    QFETCH(QByteArray, bytes);
    QFETCH(QString, expected);
    QCOMPARE(HelpFile::decode(bytes), expected);
}

void HelpFileTest::loadReadsNamedFileFromFolder() {
    QTemporaryDir dir;
    QVERIFY(dir.isValid());
    QFile other(dir.filePath("HelpOther.txt"));
    QVERIFY(other.open(QIODevice::WriteOnly));
    other.write("Enable\r\n\r\ntext\r\n#\r\nDisable\r\n#\r\n");
    other.close();

    const QStringList topics = HelpFile::load(dir.path(), HelpKind::Other);
    QCOMPARE(topics.size(), 8);
    QCOMPARE(topics.at(0), "Enable" + CRLF + CRLF + "text" + CRLF);
    QCOMPARE(topics.at(1), "Disable" + CRLF);
    QCOMPARE(topics.at(7), QString());
    // The general help reads its own file, which is missing here.
    QCOMPARE(HelpFile::load(dir.path(), HelpKind::General), QStringList(13, QString()));
}

void HelpFileTest::missingFileGivesEmptyTopics() {
    QCOMPARE(HelpFile::load(QStringLiteral("/nonexistent/folder"), HelpKind::General),
             QStringList(13, QString()));
    QCOMPARE(HelpFile::load(QString(), HelpKind::Other).size(), 8);
}

void HelpFileTest::composePrintText() {
    const QStringList topics{"A" + CRLF, "B" + CRLF + CRLF, "C" + CRLF};
    const QString gap = CRLF + CRLF + CRLF;
    QCOMPARE(HelpFile::composePrintText(topics, 2), "A" + CRLF + gap + "B" + CRLF + CRLF + gap);
    QCOMPARE(HelpFile::composePrintText(topics, 4),
             "A" + CRLF + gap + "B" + CRLF + CRLF + gap + "C" + CRLF + gap + gap);
    QCOMPARE(HelpFile::composePrintText(topics, 0), QString());
}

void HelpFileTest::shippedFiles_data() {
    QTest::addColumn<HelpKind>("kind");
    QTest::newRow("general") << HelpKind::General;
    QTest::newRow("other") << HelpKind::Other;
}

// The installed help files: CR LF line ends, exactly the expected blocks, and each topic's title
// names the label that shows it.
void HelpFileTest::shippedFiles() {
    QFETCH(HelpKind, kind);
    const QString folder = qEnvironmentVariable("TELVIO_DATA_DIR");
    QVERIFY2(!folder.isEmpty(), "TELVIO_DATA_DIR is not set");
    QFile file(QDir(folder).filePath(HelpFile::fileName(kind)));
    QVERIFY2(file.open(QIODevice::ReadOnly), qPrintable(file.fileName()));
    const QByteArray bytes = file.readAll();

    QCOMPARE(bytes.count('\n'), bytes.count("\r\n"));
    QVERIFY(bytes.endsWith("#\r\n"));
    const QList<QByteArray> lines = bytes.split('\n');
    qsizetype ends = 0;
    for (const QByteArray& line : lines) {
        if (line == "#\r")
            ++ends;
        QVERIFY2(line.size() <= 72, line.constData()); // fits the window and the printed page
    }
    QCOMPARE(ends, HelpFile::topicCount(kind));

    const QStringList topics = HelpFile::load(folder, kind);
    const QStringList captions = HelpFile::topicCaptions(kind);
    QCOMPARE(captions.size(), HelpFile::topicCount(kind));
    for (int i = 0; i < topics.size(); ++i) {
        const QString title = topics.at(i).section(CRLF, 0, 0);
        QCOMPARE(title.simplified(), captions.at(i).simplified());
        QVERIFY2(topics.at(i).count(CRLF) >= 3, qPrintable(title));
    }
}

QTEST_GUILESS_MAIN(HelpFileTest)
#include "HelpFile_test.moc"
