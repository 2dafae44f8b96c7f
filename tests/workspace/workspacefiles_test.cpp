#include "workspace/DelimitedFieldReader.h"
#include "workspace/FindText.h"
#include "workspace/TextFileCodec.h"

#include <QTest>

class WorkspaceFilesTest : public QObject {
    Q_OBJECT
private slots:
    void readsDelimitedFields_data();
    void readsDelimitedFields();
    void roundTripsEncoding_data();
    void roundTripsEncoding();
    void decodesBytes_data();
    void decodesBytes();
    void finds_data();
    void finds();
};

void WorkspaceFilesTest::readsDelimitedFields_data() {
    QTest::addColumn<QString>("file");
    QTest::addColumn<QString>("expected");
    auto row = [](const char* tag, const char* file, const char* expected) {
        QTest::newRow(tag) << QString(file) << QString(expected);
    };
    row("comma starts new line", "a,b\n", "a\nb\n");
    row("leading blanks skipped", "  lead\n\tx, y\n", "lead\nx\ny\n");
    row("trailing blanks kept", "trail  \n", "trail  \n");
    row("quoted comma", "\"q,uoted\",x\n", "q,uoted\nx\n");
    row("quoted line break", "\"multi\nline\"\n", "multi\nline\n");
    row("quoted ends with line feed", "\"ends\n\"\nz\n", "ends\nz\n");
    row("after closing quote ignored", "\"q\" junk,z", "q\nz\n");
    row("unclosed quote", "\"unclosed, still\n", "unclosed, still\n");
    row("comma before line end", "a,\nb\n", "a\n\nb\n");
    row("comma at end", "a,", "a\n\n");
    row("blank lines kept", "\n\nb", "\n\nb\n");
    row("CR LF", "x\r\ny\r\n", "x\ny\n");
    row("CR only", "x\ry", "x\ny\n");
    row("empty", "", "");
    row("saved csv", "Date Time,,\n01/02/2024 10:11:12,7.00,,25.0,\n",
        "Date Time\n\n\n01/02/2024 10:11:12\n7.00\n\n25.0\n\n");
    row("saved txt with header", "Date       Time      Reading\r\n01/02/2024 10:11:12   7.00 pH\n",
        "Date       Time      Reading\n01/02/2024 10:11:12   7.00 pH\n");
}

void WorkspaceFilesTest::readsDelimitedFields() {
    QFETCH(QString, file);
    QFETCH(QString, expected);
    QCOMPARE(DelimitedFieldReader::toWorkspaceText(file), expected);
}

void WorkspaceFilesTest::roundTripsEncoding_data() {
    QTest::addColumn<QString>("text");
    QTest::addColumn<QByteArray>("bytes");
    QTest::newRow("ascii") << "7.00 pH\n" << QByteArray("7.00 pH\n");
    QTest::newRow("degree sign as one byte") << QString::fromUtf8("25.0\u00B0C\n")
                                             << QByteArray("25.0\xB0"
                                                           "C\n");
    QTest::newRow("instrument control bytes")
        << QString::fromLatin1("\x01\xFF\r\n") << QByteArray("\x01\xFF\r\n");
    QTest::newRow("beyond Latin-1 as UTF-8")
        << QString::fromUtf8("5 \u20AC, 25\u00B0\n") << QByteArray("5 \xE2\x82\xAC, 25\xC2\xB0\n");
    QTest::newRow("empty") << QString() << QByteArray();
}

void WorkspaceFilesTest::roundTripsEncoding() {
    QFETCH(QString, text);
    QFETCH(QByteArray, bytes);
    QCOMPARE(TextFileCodec::encode(text), bytes);
    QCOMPARE(TextFileCodec::decode(bytes), text);
}

void WorkspaceFilesTest::decodesBytes_data() {
    QTest::addColumn<QByteArray>("bytes");
    QTest::addColumn<QString>("expected");
    QTest::newRow("valid UTF-8") << QByteArray("\xC3\xA9t\xC3\xA9")
                                 << QString::fromUtf8("\u00E9t\u00E9");
    QTest::newRow("truncated UTF-8 at end")
        << QByteArray("ab\xC3") << QString::fromLatin1("ab\xC3");
    QTest::newRow("Latin-1 word") << QByteArray("caf\xE9 25\xB0")
                                  << QString::fromLatin1("caf\xE9 25\xB0");
}

void WorkspaceFilesTest::decodesBytes() {
    QFETCH(QByteArray, bytes);
    QFETCH(QString, expected);
    QCOMPARE(TextFileCodec::decode(bytes), expected);
}

void WorkspaceFilesTest::finds_data() {
    QTest::addColumn<QString>("text");
    QTest::addColumn<QString>("search");
    QTest::addColumn<int>("findStart");
    QTest::addColumn<int>("expected");
    auto row = [](const char* tag, const QString& text, const QString& search, int findStart,
                  int expected) { QTest::newRow(tag) << text << search << findStart << expected; };
    row("caret at start skips first", "abcabc", "abc", 2, 4);
    row("wrap to position 1", "abcxyz", "abc", 2, 1);
    row("wrap includes findStart", "xabc", "abc", 2, 2);
    row("wrap stops at findStart", "xyabc", "ab", 4, 3);
    row("case ignored", "Cond MS/CM", "ms/cm", 1, 6);
    row("Latin-1 case", QString::fromLatin1("temp \xC9t\xE9"), QString::fromLatin1("\xE9T\xC9"), 1,
        6);
    row("overlapping", "aaaa", "aa", 3, 3);
    row("next after last wraps", "ab ab", "ab", 5, 1);
    row("not found", "abc", "zz", 2, 0);
    row("start 1 no wrap", "abc", "zz", 1, 0);
    row("start beyond end", "abc", "b", 10, 2);
    row("empty search", "abc", "", 1, 0);
    row("empty text", "", "a", 1, 0);
    row("longer than text", "ab", "abc", 1, 0);
}

void WorkspaceFilesTest::finds() {
    QFETCH(QString, text);
    QFETCH(QString, search);
    QFETCH(int, findStart);
    QFETCH(int, expected);
    QCOMPARE(FindText::find(text, search, findStart), qsizetype(expected));
}

QTEST_APPLESS_MAIN(WorkspaceFilesTest)
#include "workspacefiles_test.moc"
