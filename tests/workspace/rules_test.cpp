// The workspace's text rules, each as one table: comma-delimited lines, unit and asterisk
// conversions, reading files back as delimited fields, find, and the default file extension.
#include "core/readings/ReadingConversions.h"
#include "core/text/CommaDelimited.h"
#include "core/text/DelimitedFieldReader.h"
#include "core/text/FindText.h"
#include "core/text/SaveNames.h"

#include <QTest>

using Row = std::pair<const char*, const char*>;

class RulesTest : public QObject {
    Q_OBJECT
private slots:
    void commaDelimited() {
        // clang-format off
        const Row rows[] = {
            {"01/02/2024 10:11:12  7.00 pH  25.0 C\n", "01/02/2024 10:11:12,7.00,,25.0,\n"},
            {"abc def ghi\n", "abc def,\n"}, {"d t  +OVR mS\n", "d t, OVR,\n"}, {",a b\n", ",\n"},
            {"d t  -OVR\n", "d t, OVR\n"}, {"d t  +1 OVR\n", "d t,+1,OVR\n"},
            {"1 2 1E-3 1e5\n", "1 2,1E-3,15\n"}, {"Title\n\nx\n  7 8 9\n", "Title\n\nx\n 7,8,9\n"},
            {"1 2 pH\r\n", "1 2,\n"}, {"1 2 3\nend", "1 2,3\nend"}, {"", ""}};
        // clang-format on
        for (auto [in, out] : rows)
            QCOMPARE(CommaDelimited::convert(in), out);
    }

    // Flags: 1 = mS to uS, 2 = ppK to ppM, 4 = asterisks. A second run over converted text
    // changes nothing.
    void readingConversions() {
        auto with = [](int on) {
            return ReadingConversions{bool(on & 1), bool(on & 2), bool(on & 4)};
        };
        // clang-format off
        const std::tuple<int, const char*, const char*> rows[] = {
            {1, "ab 1.413mS\n", "ab  1413uS\n"}, {1, "ab1*2345mS\n", "ab1234*5uS\n"},
            {1, "ab1234.5mS\n", "ab  +OVRuS\n"}, {1, "ab0.0013mS\n", "ab   1.3uS\n"},
            {1, "abc -100.0mS\n", "abc-100000uS\n"}, {1, "1.41mS\n", "1410uS\n"},
            // A rendering that would reach before the text or into the line above is not written.
            {1, "abc\n-99999mS\n", "abc\n-99999uS\n"}, {1, "12.5mS\n", "12.5uS\n"},
            {1, "1mS 1.41mS", "1mS 1.41uS"}, {2, "ab 1.413mS 0*525ppK\n", "ab 1.413mS   525ppM\n"},
            {5, "ab1*2345mS 7*00\n", "ab1234.5uS 7.00\n"}, {0, "1.41mS 0*5ppK", "1.41mS 0*5ppK"},
            // The value field ends at a line break, which is never overwritten.
            {1, "x\n1.413mS", "x\n 1413uS"}, {1, "x\r1.413mS", "x\r 1413uS"},
            {1, "abc\n1*5mS", "abc\n1*5uS"}, {1, "\n--.--mS", "\n--.--uS"}};
        // clang-format on
        for (auto [on, in, out] : rows) {
            QCOMPARE(with(on).apply(in), out);
            QCOMPARE(with(on).apply(out), out);
        }
        // One value field alone; an empty result means "not a number".
        const Row fields[] = {{"999.999", "999999"}, {"999.9991", "+OVR"}, {" -0.00", "0"},
                              {" 1.2.3", ""},        {"  - 12", ""},       {"   1E2", ""},
                              {"\n12.34", ""}};
        for (auto [in, out] : fields)
            QCOMPARE(ReadingConversions::convertValueField(QString(in)).value_or(""), out);
    }

    void delimitedFields() {
        // clang-format off
        const Row rows[] = {
            {"a,b\n", "a\nb\n"}, {"  lead\n\tx, y  \n", "lead\nx\ny  \n"}, {"a,\nb\n", "a\n\nb\n"},
            {"\"q,uoted\",x\n", "q,uoted\nx\n"}, {"\"ends\n\"\nz\n", "ends\nz\n"}, {"", ""},
            {"\"q\" junk,z", "q\nz\n"}, {"\"open, still\n", "open, still\n"}, {"\n\nb", "\n\nb\n"},
            {"x\r\ny\rz", "x\ny\nz\n"}};
        // clang-format on
        for (auto [in, out] : rows)
            QCOMPARE(DelimitedFieldReader::toWorkspaceText(QString(in)), out);
    }

    // Positions count from 1; 0 is "not found". The control shows a CR LF as one line break.
    void findAndNames() {
        const std::tuple<const char*, const char*, int, int> rows[] = {
            {"abcabc", "abc", 2, 4}, {"abcxyz", "abc", 2, 1},
            {"xabc", "abc", 2, 2},   {"Cond MS/CM", "ms/cm", 1, 6},
            {"aaaa", "aa", 3, 3},    {"abc", "zz", 2, 0},
            {"abc", "", 1, 0}};
        for (auto [text, search, start, found] : rows)
            QCOMPARE(FindText::find(text, search, start), qsizetype(found));
        QCOMPARE(FindText::documentPosition("ab\r\ncd\r\nxy", 8), qsizetype(6));
        QCOMPARE(FindText::textIndex("ab\r\ncd\r\nxy", 6), qsizetype(8));
        // A dot anywhere, also in a folder name, keeps the name as typed.
        QCOMPARE(SaveNames::withDefaultExtension("v1.2/run", 1), "v1.2/run");
    }
};

QTEST_APPLESS_MAIN(RulesTest)
#include "rules_test.moc"
