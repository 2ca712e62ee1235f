#include "TestVersions.h"

#include "export/RssExport.h"
#include "export/SqlExport.h"

#include <QDir>
#include <QFile>
#include <QLocale>
#include <QTemporaryDir>
#include <QTimeZone>
#include <QtTest>

#include <memory>

using namespace verbloom;

namespace {

const QString kData = QStringLiteral(VERBLOOM_TEST_DATA);

// The article as the analysis leaves it (closing blanks appended), then numbered versions.
ArticleBoxes Article()
{
    return {QStringLiteral("Spring \"Garden\" Tips & Tricks "),
            QStringLiteral("Plant early.\r\nWater <often> & well ]]> done. ")};
}

QString VersionTitle(int k)
{
    return QStringLiteral("Spring Garden Tip %1 & More").arg(k);
}

QString VersionContents(int k)
{
    return QStringLiteral("Plant \"early\" %1.\r\nWater <often> & well. ").arg(k);
}

NumberedVersions Versions()
{
    return NumberedVersions(&VersionTitle, &VersionContents);
}

// A clock that starts on Sunday 6 December 2026, 14:03:09 at UTC+1 and moves one second a call.
Clock TestClock()
{
    auto when = std::make_shared<QDateTime>(QDate(2026, 12, 6), QTime(14, 3, 9), Qt::OffsetFromUTC, 3600);
    return [when] {
        const QDateTime now = *when;
        *when = when->addSecs(1);
        return now;
    };
}

SqlExportOptions SqlOptions(const QString &path)
{
    SqlExportOptions options;
    options.FileName = path;
    options.TableName = QStringLiteral("articles");
    options.TitleFieldName = QStringLiteral("title");
    options.ArticleFieldName = QStringLiteral("body");
    return options;
}

RssExportOptions RssOptions(const QString &path, const QString &count, const QString &chars)
{
    return {path, count, QStringLiteral("http://example.com/feed?a=1&b=2"), chars};
}

} // namespace

class TestExport final : public QObject
{
    Q_OBJECT

private slots:
    void init();

    void validatesSqlForm_data();
    void validatesSqlForm();
    void writesSqlStatements_data();
    void writesSqlStatements();
    void sqlRefusesCountOutsideRange_data();
    void sqlRefusesCountOutsideRange();
    void sqlWithoutTitlesLeavesFileUntouched();
    void sqlReportsUnwritableFile();
    void sqlSecondExportOverwrites();

    void validatesXmlForm_data();
    void validatesXmlForm();
    void writesFeed_data();
    void writesFeed();
    void rssCountsThatDoNothingOrAreRefused_data();
    void rssCountsThatDoNothingOrAreRefused();
    void rssReportsUnwritableFile();
    void cutsDescriptions_data();
    void cutsDescriptions();
    void formatsRfc822Dates_data();
    void formatsRfc822Dates();
    void splitsCdataEnd();

private:
    std::unique_ptr<QTemporaryDir> m_dir;
    QString Path(const QString &name) const { return m_dir->filePath(name); }
};

void TestExport::init()
{
    m_dir = std::make_unique<QTemporaryDir>();
    QVERIFY(m_dir->isValid());
}

void TestExport::validatesSqlForm_data()
{
    QTest::addColumn<QStringList>("fields"); // file, table, title field, article field, count
    QTest::addColumn<QString>("decimalPoint");
    QTest::addColumn<QString>("message"); // "" when valid

    const QString dot = QStringLiteral(".");
    QTest::newRow("all empty") << QStringList{u""_qs, u""_qs, u""_qs, u""_qs, u""_qs} << dot
                               << u"Please enter file name"_qs;
    QTest::newRow("table") << QStringList{u"f"_qs, u""_qs, u""_qs, u""_qs, u""_qs} << dot
                           << u"Please enter Table name"_qs;
    QTest::newRow("title field") << QStringList{u"f"_qs, u"t"_qs, u""_qs, u""_qs, u""_qs} << dot
                                 << u"Please enter Title field name"_qs;
    QTest::newRow("article field") << QStringList{u"f"_qs, u"t"_qs, u"a"_qs, u""_qs, u""_qs} << dot
                                   << u"Please enter Article field name"_qs;
    QTest::newRow("count empty") << QStringList{u"f"_qs, u"t"_qs, u"a"_qs, u"b"_qs, u""_qs} << dot
                                 << u"Please specify No of article to insert"_qs;
    QTest::newRow("count word") << QStringList{u"f"_qs, u"t"_qs, u"a"_qs, u"b"_qs, u"ten"_qs} << dot
                                << u"No of article to insert should be numeric"_qs;
    QTest::newRow("count blanks") << QStringList{u"f"_qs, u"t"_qs, u"a"_qs, u"b"_qs, u"  "_qs} << dot
                                  << u"No of article to insert should be numeric"_qs;
    QTest::newRow("blanks pass") << QStringList{u" "_qs, u" "_qs, u" "_qs, u" "_qs, u" 10 "_qs} << dot << u""_qs;
    QTest::newRow("exponent") << QStringList{u"f"_qs, u"t"_qs, u"a"_qs, u"b"_qs, u"1e1"_qs} << dot << u""_qs;
    QTest::newRow("locale comma") << QStringList{u"f"_qs, u"t"_qs, u"a"_qs, u"b"_qs, u"2,5"_qs}
                                  << QStringLiteral(",") << u""_qs;
    QTest::newRow("dot under comma locale")
        << QStringList{u"f"_qs, u"t"_qs, u"a"_qs, u"b"_qs, u"2.5"_qs} << QStringLiteral(",")
        << u"No of article to insert should be numeric"_qs;
    QTest::newRow("zero") << QStringList{u"f"_qs, u"t"_qs, u"a"_qs, u"b"_qs, u"0"_qs} << dot
                          << u"No of article to insert should be between 1 and 32767"_qs;
    QTest::newRow("0.5 rounds to 0") << QStringList{u"f"_qs, u"t"_qs, u"a"_qs, u"b"_qs, u"0.5"_qs} << dot
                                     << u"No of article to insert should be between 1 and 32767"_qs;
    QTest::newRow("max") << QStringList{u"f"_qs, u"t"_qs, u"a"_qs, u"b"_qs, u"32767"_qs} << dot << u""_qs;
}

void TestExport::validatesSqlForm()
{
    QFETCH(QStringList, fields);
    QFETCH(QString, decimalPoint);
    QFETCH(QString, message);
    const SqlExportOptions options{fields[0], fields[1], fields[2], fields[3], fields[4]};
    const std::optional<UserMessage> failure = ValidateSqlForm(options, decimalPoint.at(0));
    if (message.isEmpty()) {
        QVERIFY2(!failure, qPrintable(failure ? failure->Text : QString()));
        return;
    }
    QVERIFY(failure);
    QCOMPARE(failure->Text, message);
    QCOMPARE(failure->Title, u"Message"_qs);
    QCOMPARE(failure->IconKind, UserMessage::Icon::Information);
    QCOMPARE(failure->ButtonSet, UserMessage::Buttons::Ok);
}

void TestExport::writesSqlStatements_data()
{
    QTest::addColumn<QString>("count");
    QTest::addColumn<QString>("tableName");
    QTest::addColumn<QString>("articleField");
    QTest::addColumn<QString>("initialTitle");
    QTest::addColumn<QString>("golden");
    QTest::addColumn<int>("statements");
    QTest::addColumn<QString>("fieldAfter");
    QTest::addColumn<int>("versionInBoxes");

    QTest::newRow("count 1") << u"1"_qs << u"articles"_qs << u"body"_qs << Article().Title
                             << u"sql_count1.sql"_qs << 1 << u"body"_qs << 2;
    QTest::newRow("count 2.5 gives 2") << u"2.5"_qs << u"articles"_qs << u"body"_qs << Article().Title
                                       << u"sql_count2_5.sql"_qs << 2 << u"body"_qs << 3;
    QTest::newRow("count 3.5 gives 4, quotes") << u"3.5"_qs << u"my table"_qs << u"body\"text\""_qs
                                               << Article().Title << u"sql_count3_5.sql"_qs << 4
                                               << u"body'text'"_qs << 5;
    QTest::newRow("empty title skipped") << u"3"_qs << u"articles"_qs << u"body"_qs << QString()
                                         << u"sql_empty_title.sql"_qs << 2 << u"body"_qs << 4;
}

void TestExport::writesSqlStatements()
{
    QFETCH(QString, count);
    QFETCH(QString, tableName);
    QFETCH(QString, articleField);
    QFETCH(QString, initialTitle);
    QFETCH(QString, golden);
    QFETCH(int, statements);
    QFETCH(QString, fieldAfter);
    QFETCH(int, versionInBoxes);

    SqlExportOptions options = SqlOptions(Path(golden));
    options.Count = count;
    options.TableName = tableName;
    options.ArticleFieldName = articleField;
    ArticleBoxes boxes{initialTitle, Article().Contents};
    NumberedVersions versions = Versions();

    const SqlExportResult result = ExportSql(options, boxes, versions);
    QCOMPARE(result.Outcome, ExportResult::Status::Written);
    QCOMPARE(result.Versions, statements);
    QCOMPARE(result.ArticleFieldName, fieldAfter);
    QCOMPARE(ReadBytes(Path(golden)), ReadBytes(kData + u"/"_qs + golden));
    // The boxes hold the next version, which no statement carries.
    QCOMPARE(boxes.Title, VersionTitle(versionInBoxes));
    QCOMPARE(boxes.Contents, VersionContents(versionInBoxes));
    QCOMPARE(result.OpenOnYes, Path(golden));
    QCOMPARE(result.Messages.size(), 1);
    QCOMPARE(result.Messages[0].Text, u"File Saved as "_qs + Path(golden) + u"\r\nDo you want to open it?"_qs);
    QCOMPARE(result.Messages[0].Title, u"Verbloom"_qs);
    QCOMPARE(result.Messages[0].ButtonSet, UserMessage::Buttons::YesNo);
    QCOMPARE(result.Messages[0].IconKind, UserMessage::Icon::Information);
}

void TestExport::sqlRefusesCountOutsideRange_data()
{
    QTest::addColumn<QString>("count");
    QTest::newRow("0") << u"0"_qs;
    QTest::newRow("-3") << u"-3"_qs;
    QTest::newRow("32768") << u"32768"_qs;
    QTest::newRow("32767.5 rounds to 32768") << u"32767.5"_qs;
    QTest::newRow("-40000") << u"-40000"_qs;
}

void TestExport::sqlRefusesCountOutsideRange()
{
    QFETCH(QString, count);
    const QString path = Path(u"kept.sql"_qs);
    {
        QFile file(path);
        QVERIFY(file.open(QIODevice::WriteOnly));
        file.write("old");
    }
    SqlExportOptions options = SqlOptions(path);
    options.Count = count;
    ArticleBoxes boxes = Article();
    NumberedVersions versions = Versions();
    const SqlExportResult result = ExportSql(options, boxes, versions);
    QCOMPARE(result.Outcome, ExportResult::Status::Invalid);
    QCOMPARE(result.Messages.size(), 1);
    QCOMPARE(result.Messages[0].Text, u"No of article to insert should be between 1 and 32767"_qs);
    QCOMPARE(ReadBytes(path), QByteArray("old"));
    QCOMPARE(boxes.Title, Article().Title);
    QCOMPARE(versions.TitlesMade(), 0);
}

void TestExport::sqlWithoutTitlesLeavesFileUntouched()
{
    const QString path = Path(u"untouched.sql"_qs);
    {
        QFile file(path);
        QVERIFY(file.open(QIODevice::WriteOnly));
        file.write("old");
    }
    SqlExportOptions options = SqlOptions(path);
    options.Count = u"3"_qs;
    options.ArticleFieldName = u"a\"b"_qs;
    ArticleBoxes boxes{QString(), u"text "_qs};
    NumberedVersions versions([](int) { return QString(); }, &VersionContents);
    const SqlExportResult result = ExportSql(options, boxes, versions);
    QCOMPARE(result.Outcome, ExportResult::Status::NothingWritten);
    QCOMPARE(result.Messages.size(), 1);
    QCOMPARE(result.Messages[0].Text, u"Nothing was saved: every version had an empty title"_qs);
    QCOMPARE(result.ArticleFieldName, u"a\"b"_qs); // no statement, the box keeps its quote
    QCOMPARE(ReadBytes(path), QByteArray("old"));
    QCOMPARE(versions.TitlesMade(), 3); // the boxes still moved on three times
    QCOMPARE(QDir(m_dir->path()).entryList(QDir::Files), QStringList{u"untouched.sql"_qs});
}

void TestExport::sqlReportsUnwritableFile()
{
    const QString path = Path(u"missing-folder/out.sql"_qs);
    SqlExportOptions options = SqlOptions(path);
    ArticleBoxes boxes = Article();
    NumberedVersions versions = Versions();
    const SqlExportResult result = ExportSql(options, boxes, versions);
    QCOMPARE(result.Outcome, ExportResult::Status::WriteFailed);
    QCOMPARE(result.Messages.size(), 1);
    QVERIFY(result.Messages[0].Text.startsWith(u"File could not be saved as "_qs + path));
    QCOMPARE(result.Messages[0].IconKind, UserMessage::Icon::Exclamation);
    QVERIFY(result.OpenOnYes.isEmpty());
    QCOMPARE(boxes.Title, Article().Title); // reported before any version was made
    QVERIFY(!QFile::exists(path));
}

void TestExport::sqlSecondExportOverwrites()
{
    const QString path = Path(u"twice.sql"_qs);
    SqlExportOptions options = SqlOptions(path);
    options.Count = u"1"_qs;
    ArticleBoxes boxes = Article();
    NumberedVersions versions = Versions();
    QCOMPARE(ExportSql(options, boxes, versions).Outcome, ExportResult::Status::Written);
    QCOMPARE(ExportSql(options, boxes, versions).Outcome, ExportResult::Status::Written);
    QCOMPARE(ReadBytes(path),
             SqlStatement(u"articles"_qs, u"title"_qs, u"body"_qs, VersionTitle(2), VersionContents(2)).toUtf8());
    QCOMPARE(boxes.Title, VersionTitle(3));
}

void TestExport::validatesXmlForm_data()
{
    QTest::addColumn<QStringList>("fields"); // file, count, url, chars
    QTest::addColumn<QString>("message");
    QTest::newRow("file") << QStringList{u""_qs, u""_qs, u""_qs, u""_qs} << u"Please enter file name"_qs;
    QTest::newRow("count") << QStringList{u"f"_qs, u""_qs, u""_qs, u""_qs} << u"Please enter no of record"_qs;
    QTest::newRow("count word") << QStringList{u"f"_qs, u"x"_qs, u""_qs, u""_qs}
                                << u"No of record should be numeric"_qs;
    QTest::newRow("url") << QStringList{u"f"_qs, u"3"_qs, u""_qs, u""_qs} << u"Please enter url"_qs;
    QTest::newRow("chars") << QStringList{u"f"_qs, u"3"_qs, u"u"_qs, u""_qs}
                           << u"Please enter no of character for description"_qs;
    QTest::newRow("chars word") << QStringList{u"f"_qs, u"3"_qs, u"u"_qs, u"100x"_qs}
                                << u"no of character for description should be numeric"_qs;
    QTest::newRow("valid, blanks") << QStringList{u" "_qs, u" 3 "_qs, u" "_qs, u"-1.5e2"_qs} << QString();
}

void TestExport::validatesXmlForm()
{
    QFETCH(QStringList, fields);
    QFETCH(QString, message);
    const std::optional<UserMessage> failure = ValidateXmlForm({fields[0], fields[1], fields[2], fields[3]});
    QCOMPARE(failure ? failure->Text : QString(), message);
    if (failure) {
        QCOMPARE(failure->Title, u"Message"_qs);
        QCOMPARE(failure->IconKind, UserMessage::Icon::Information);
    }
}

void TestExport::writesFeed_data()
{
    QTest::addColumn<QString>("count");
    QTest::addColumn<QString>("chars");
    QTest::addColumn<QString>("emptied"); // the box that is empty when the export starts
    QTest::addColumn<QString>("golden");
    QTest::addColumn<int>("items");

    QTest::newRow("3 items, channel title of row 2") << u"3"_qs << u"100"_qs << QString() << u"rss_3items.xml"_qs << 3;
    QTest::newRow("1 item, empty channel title") << u" 1 "_qs << u"100"_qs << QString() << u"rss_1item.xml"_qs << 1;
    QTest::newRow("descriptions cut at 10") << u"3"_qs << u"10"_qs << QString() << u"rss_limit10.xml"_qs << 3;
    // An empty box makes no row and no new version, however many versions the spinner could make.
    QTest::newRow("empty title, no rows") << u"2"_qs << u"100"_qs << u"title"_qs << u"rss_empty.xml"_qs << 0;
    QTest::newRow("empty contents, no rows") << u"2"_qs << u"100"_qs << u"contents"_qs << u"rss_empty.xml"_qs << 0;
}

void TestExport::writesFeed()
{
    QFETCH(QString, count);
    QFETCH(QString, chars);
    QFETCH(QString, emptied);
    QFETCH(QString, golden);
    QFETCH(int, items);

    const QString path = Path(golden);
    ArticleBoxes boxes = Article();
    if (emptied == u"title"_qs)
        boxes.Title.clear();
    else if (emptied == u"contents"_qs)
        boxes.Contents.clear();
    const ArticleBoxes before = boxes;
    NumberedVersions versions = Versions();
    const ExportResult result = ExportRss(RssOptions(u"  "_qs + path + u" "_qs, count, chars), boxes, versions,
                                          TestClock());
    QCOMPARE(result.Outcome, ExportResult::Status::Written);
    QCOMPARE(result.FileName, path); // XmlFileName is trimmed
    QCOMPARE(result.Versions, items);
    QCOMPARE(ReadBytes(path), ReadBytes(kData + u"/"_qs + golden));
    QCOMPARE(result.Messages.size(), 1);
    QCOMPARE(result.Messages[0], FileSavedQuestion(path));
    QCOMPARE(result.OpenOnYes, path);
    QCOMPARE(versions.TitlesMade(), items);
    if (items == 0) {
        QCOMPARE(boxes.Title, before.Title);
        QCOMPARE(boxes.Contents, before.Contents);
    }
}

void TestExport::rssCountsThatDoNothingOrAreRefused_data()
{
    QTest::addColumn<QString>("fileName");
    QTest::addColumn<QString>("count");
    QTest::addColumn<int>("outcome");
    QTest::addColumn<QString>("message");
    QTest::newRow("0 does nothing") << u"f.xml"_qs << u"0"_qs << int(ExportResult::Status::NothingToDo) << QString();
    QTest::newRow("-2 does nothing") << u"f.xml"_qs << u"-2"_qs << int(ExportResult::Status::NothingToDo)
                                     << QString();
    QTest::newRow("-40000 does nothing") << u"f.xml"_qs << u"-40000"_qs
                                         << int(ExportResult::Status::NothingToDo) << QString();
    QTest::newRow("above 32767") << u"f.xml"_qs << u"32768"_qs << int(ExportResult::Status::Invalid)
                                 << u"No of record should not be more than 32767"_qs;
    QTest::newRow("blank file name") << u"   "_qs << u"2"_qs << int(ExportResult::Status::Invalid)
                                     << u"Please enter file name"_qs;
}

void TestExport::rssCountsThatDoNothingOrAreRefused()
{
    QFETCH(QString, fileName);
    QFETCH(QString, count);
    QFETCH(int, outcome);
    QFETCH(QString, message);
    ArticleBoxes boxes = Article();
    NumberedVersions versions = Versions();
    const QString path = fileName.trimmed().isEmpty() ? fileName : Path(fileName);
    const ExportResult result = ExportRss(RssOptions(path, count, u"100"_qs), boxes, versions, TestClock());
    QCOMPARE(int(result.Outcome), outcome);
    QCOMPARE(result.Messages.isEmpty() ? QString() : result.Messages[0].Text, message);
    QCOMPARE(versions.TitlesMade(), 0);
    QCOMPARE(boxes.Title, Article().Title);
    QVERIFY(QDir(m_dir->path()).isEmpty());
}

void TestExport::rssReportsUnwritableFile()
{
    const QString path = Path(u"no/such/folder/feed.xml"_qs);
    ArticleBoxes boxes = Article();
    NumberedVersions versions = Versions();
    const ExportResult result = ExportRss(RssOptions(path, u"2"_qs, u"5"_qs), boxes, versions, TestClock());
    QCOMPARE(result.Outcome, ExportResult::Status::WriteFailed);
    QCOMPARE(result.Messages.size(), 1);
    QVERIFY(result.Messages[0].Text.startsWith(u"File could not be saved as "_qs + path));
    QVERIFY(result.OpenOnYes.isEmpty());
}

void TestExport::cutsDescriptions_data()
{
    QTest::addColumn<int>("length");
    QTest::addColumn<double>("limit");
    QTest::addColumn<int>("expected");
    QTest::newRow("250 cut at 100") << 250 << 100.0 << 100;
    QTest::newRow("80 under 100") << 80 << 100.0 << 80;
    QTest::newRow("limit 0") << 80 << 0.0 << 0;
    QTest::newRow("exact") << 100 << 100.0 << 100;
    QTest::newRow("2.5 rounds to 2") << 10 << 2.5 << 2;
    QTest::newRow("3.5 rounds to 4") << 10 << 3.5 << 4;
    QTest::newRow("length 3 within 3.4") << 3 << 3.4 << 3;
    QTest::newRow("negative") << 10 << -5.0 << 0;
    QTest::newRow("above 32767") << 40000 << 40000.0 << 40000;
}

void TestExport::cutsDescriptions()
{
    QFETCH(int, length);
    QFETCH(double, limit);
    QFETCH(int, expected);
    QString contents;
    for (int i = 0; i < length; ++i)
        contents += QChar(u'a' + i % 26);
    QCOMPARE(RssDescription(contents, limit), contents.left(expected));
}

void TestExport::formatsRfc822Dates_data()
{
    QTest::addColumn<QDateTime>("when");
    QTest::addColumn<QString>("expected");
    QTest::newRow("+0100") << QDateTime(QDate(2026, 12, 6), QTime(14, 3, 9), Qt::OffsetFromUTC, 3600)
                           << u"Sun, 06 Dec 2026 14:03:09 +0100"_qs;
    QTest::newRow("-0530") << QDateTime(QDate(2024, 2, 29), QTime(0, 0, 1), Qt::OffsetFromUTC, -(5 * 3600 + 1800))
                           << u"Thu, 29 Feb 2024 00:00:01 -0530"_qs;
    QTest::newRow("UTC") << QDateTime(QDate(2025, 7, 14), QTime(23, 59, 59), Qt::UTC)
                         << u"Mon, 14 Jul 2025 23:59:59 +0000"_qs;
}

void TestExport::formatsRfc822Dates()
{
    QFETCH(QDateTime, when);
    QFETCH(QString, expected);
    // English names whatever the user's locale.
    const QLocale saved;
    QLocale::setDefault(QLocale(QLocale::German, QLocale::Germany));
    const QString formatted = RssDate(when);
    QLocale::setDefault(saved);
    QCOMPARE(formatted, expected);
}

void TestExport::splitsCdataEnd()
{
    const QString item = RssItem(u"a<b>&c"_qs, u"u"_qs, u"x]]>y]]>"_qs,
                                 QDateTime(QDate(2026, 1, 1), QTime(0, 0), Qt::UTC));
    QCOMPARE(item, u"      <item>\r\n         <title>a&lt;b&gt;&amp;c</title>\r\n         <link>u</link>\r\n"
                   "         <description><![CDATA[ \r\nx]]]]><![CDATA[>y]]]]><![CDATA[>\r\n]]></description>\r\n"
                   "         <pubDate>Thu, 01 Jan 2026 00:00:00 +0000</pubDate>\r\n      </item>\r\n"_qs);
    // A cut never leaves half a surrogate pair.
    const QString smile = QString::fromUcs4(U"ab\U0001F600c");
    QCOMPARE(RssDescription(smile, 3), u"ab"_qs);
    QCOMPARE(RssDescription(smile, 4), smile.left(4));
}

QTEST_GUILESS_MAIN(TestExport)
#include "tst_export.moc"
