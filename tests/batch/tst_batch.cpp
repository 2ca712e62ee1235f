// verbloom-batch run as a user runs it: a fresh program folder per test, word files written here,
// the built program started with QProcess.
#include "common/TextFile.h"
#include "engine/RandomSource.h"
#include "engine/SpinGenerator.h"
#include "engine/WordStore.h"
#include "export/SpinnerVersionSource.h"
#include "export/SqlExport.h"
#include "site/SiteConfig.h"
#include "thesaurus/ThesaurusService.h"

#include <QDirIterator>
#include <QFile>
#include <QProcess>
#include <QSignalSpy>
#include <QTemporaryDir>
#include <QtTest>

#include <memory>

using namespace verbloom;

namespace {

const QString kProgram = QStringLiteral(VERBLOOM_BATCH_PROGRAM);
const QString kExportData = QStringLiteral(VERBLOOM_EXPORT_DATA);
const QString kSiteData = QStringLiteral(VERBLOOM_SITE_DATA);

// The article of the export golden files and of the site golden files, as the user enters it.
const QString kExportTitle = QStringLiteral("Spring \"Garden\" Tips & Tricks");
const QString kExportContents = QStringLiteral("Plant early.\r\nWater <often> & well ]]> done.");
const QString kSiteContents = QStringLiteral("Plant early.\r\nWater often.");

// Sunday 6 December 2026, 14:03:09 at UTC+1: the first item date of the RSS golden files.
const QString kGoldenEpoch = QStringLiteral("1796562189");
const QString kUtcPlusOne = QStringLiteral("CET-1");

struct BatchRun
{
    int ExitCode = -1;
    QByteArray Out;
    QByteArray Err;
};

QByteArray ReadBytes(const QString &path)
{
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
}

// Every file and folder below `root` with its bytes, to show what a run wrote.
QMap<QString, QByteArray> Snapshot(const QString &root)
{
    QMap<QString, QByteArray> tree;
    QDirIterator it(root, QDir::AllEntries | QDir::NoDotAndDotDot | QDir::Hidden, QDirIterator::Subdirectories);
    while (it.hasNext()) {
        const QString path = it.next();
        tree.insert(path.mid(root.size() + 1), it.fileInfo().isDir() ? QByteArray("<dir>") : ReadBytes(path));
    }
    return tree;
}

QStringList Files(const QString &folder)
{
    return QDir(folder).entryList(QDir::Files, QDir::Name);
}

// Arguments written as one text, separated by "|".
QStringList Args(const QString &joined)
{
    return joined.isEmpty() ? QStringList() : joined.split(u'|');
}

// Writes a small MyThes thesaurus (PATH.idx, PATH.dat): each entry is a word and its meaning
// lines such as "(noun)|yard|backyard".
bool WriteThesaurus(const QString &path, const QList<std::pair<QString, QStringList>> &entries)
{
    QByteArray dat = "UTF-8\n";
    QByteArray idx = "UTF-8\n" + QByteArray::number(entries.size()) + '\n';
    for (const auto &[word, meanings] : entries) {
        idx += word.toUtf8() + '|' + QByteArray::number(dat.size()) + '\n';
        dat += word.toUtf8() + '|' + QByteArray::number(meanings.size()) + '\n';
        for (const QString &meaning : meanings)
            dat += meaning.toUtf8() + '\n';
    }
    return WriteBinaryFile(path + u".dat"_qs, dat) && WriteBinaryFile(path + u".idx"_qs, idx);
}

} // namespace

class TestBatch final : public QObject
{
    Q_OBJECT

private slots:
    void init();

    void matchesExportGoldenFiles_data();
    void matchesExportGoldenFiles();
    void matchesSiteGoldenFiles_data();
    void matchesSiteGoldenFiles();
    void writesArticleAsEntered_data();
    void writesArticleAsEntered();
    void followsTheRandomSequence_data();
    void followsTheRandomSequence();
    void listsNewWords_data();
    void listsNewWords();

    void refusesBadInput_data();
    void refusesBadInput();
    void refusesBadDateEpoch();
    void siteAsksForForceOverExistingIndex();
    void reportsSiteFilesThatFail();

    void lookupWritesWordFiles();
    void lookupUsesEmbeddedThesaurus();
    void reportsWordFilesThatCannotBeWritten();

    void helpDocumentsEveryOption();

private:
    BatchRun Run(const QStringList &arguments, const QMap<QString, QString> &environment = {});
    QStringList Article(const QString &title, const QString &contents);
    void WriteWordFile(const QString &word, const QString &alternatives)
    {
        QVERIFY(WordStore(m_home).WriteAlternatives(word, alternatives));
    }
    QString Path(const QString &name) const { return m_dir->filePath(name); }

    std::unique_ptr<QTemporaryDir> m_dir;
    QString m_home;
    QString m_out;
};

void TestBatch::init()
{
    m_dir = std::make_unique<QTemporaryDir>();
    QVERIFY(m_dir->isValid());
    m_home = Path(u"home"_qs);
    m_out = Path(u"out"_qs);
    QVERIFY(QDir().mkpath(m_home + u"/templates"_qs));
    QVERIFY(QDir().mkpath(m_out));
    QVERIFY(QFile::copy(kSiteData + u"/templates/plain.htm"_qs, m_home + u"/templates/plain.htm"_qs));
}

BatchRun TestBatch::Run(const QStringList &arguments, const QMap<QString, QString> &environment)
{
    QProcess process;
    QProcessEnvironment env = QProcessEnvironment::systemEnvironment();
    env.remove(u"SOURCE_DATE_EPOCH"_qs);
    env.insert(u"LC_ALL"_qs, u"C"_qs);
    for (auto it = environment.begin(); it != environment.end(); ++it)
        env.insert(it.key(), it.value());
    process.setProcessEnvironment(env);
    // Waiting in an event loop lets a thesaurus service of this process answer the lookups.
    QSignalSpy finished(&process, &QProcess::finished);
    process.start(kProgram, arguments);
    if (!process.waitForStarted(30000))
        return {};
    if (finished.isEmpty() && !finished.wait(120000)) {
        process.kill();
        process.waitForFinished();
        return {};
    }
    return {process.exitStatus() == QProcess::NormalExit ? process.exitCode() : -1, process.readAllStandardOutput(),
            process.readAllStandardError()};
}

QStringList TestBatch::Article(const QString &title, const QString &contents)
{
    const QString file = Path(u"article.txt"_qs);
    if (!WriteTextFile(file, contents))
        qWarning("article.txt could not be written");
    return {u"--home"_qs, m_home, u"--title"_qs, title, u"--contents"_qs, file};
}

// ---------------------------------------------------------------------------------------------
// Output files

void TestBatch::matchesExportGoldenFiles_data()
{
    QTest::addColumn<QString>("golden");
    QTest::addColumn<QString>("action"); // OUT stands for the output file
    QTest::addColumn<bool>("firstStatementOnly");
    QTest::newRow("sql_count1.sql") << u"sql_count1.sql"_qs
                                    << u"--sql|OUT|--table|articles|--title-field|title|--article-field|body|--count|1"_qs
                                    << false;
    QTest::newRow("sql_count3_5.sql, first statement, quoted field")
        << u"sql_count3_5.sql"_qs
        << u"--sql|OUT|--table|my table|--title-field|title|--article-field|body\"text\"|--count|1"_qs << true;
    QTest::newRow("rss_1item.xml") << u"rss_1item.xml"_qs
                                   << u"--rss|OUT|--url|http://example.com/feed?a=1&b=2|--count| 1 |"
                                      "--description-chars|100"_qs
                                   << false;
}

void TestBatch::matchesExportGoldenFiles()
{
    QFETCH(QString, golden);
    QFETCH(QString, action);
    QFETCH(bool, firstStatementOnly);

    // Alternatives for every word: the first version is the article as entered all the same.
    for (const QString &word : {u"Spring"_qs, u"Garden"_qs, u"Tips"_qs, u"Tricks"_qs, u"Plant"_qs, u"early"_qs,
                                u"Water"_qs, u"often"_qs, u"well"_qs, u"done"_qs})
        WriteWordFile(word, u"alpha, beta"_qs);
    const QString output = m_out + u"/"_qs + golden;
    const BatchRun run = Run(Article(kExportTitle, kExportContents) + Args(u"--level|Maximum|"_qs + action)
                                 .replaceInStrings(u"OUT"_qs, output),
                             {{u"SOURCE_DATE_EPOCH"_qs, kGoldenEpoch}, {u"TZ"_qs, kUtcPlusOne}});
    QCOMPARE(run.Err, QByteArray());
    QCOMPARE(run.ExitCode, 0);
    QCOMPARE(run.Out, QByteArray());
    QByteArray expected = ReadBytes(kExportData + u"/"_qs + golden);
    QVERIFY(!expected.isEmpty());
    if (firstStatementOnly) // up to and including the first ");" CR LF
        expected.truncate(expected.indexOf(");\r\n") + 4);
    QCOMPARE(ReadBytes(output), expected);
}

void TestBatch::matchesSiteGoldenFiles_data()
{
    QTest::addColumn<QString>("golden");
    QTest::addColumn<QString>("title");
    QTest::addColumn<QString>("caption");
    QTest::addColumn<bool>("lowercase");
    QTest::addColumn<bool>("index");
    QTest::addColumn<bool>("sitemap");
    QTest::addColumn<QString>("flags");
    QTest::addColumn<QStringList>("compared"); // files whose every byte can be reproduced

    // Pages 2 onward carry customized versions, which the golden files do not hold; page 1 carries
    // the article as entered, and the site map only names the pages.
    QTest::newRow("0 pages") << u"site_0pages"_qs << u"Garden Tips"_qs << u"Link"_qs << true << true << true
                             << u"--pages|0"_qs << QStringList{u"index.htm"_qs, u"sitemap.htm"_qs};
    QTest::newRow("25 x 10, options of config.txt") << u"site_25x10"_qs << u"Garden Tips"_qs << u"Link"_qs << true
                                                    << true << true << QString()
                                                    << QStringList{u"page1.htm"_qs, u"sitemap.htm"_qs};
    QTest::newRow("3 x 10, cleaned caption, extension flag")
        << u"site_3x10"_qs << u"Garden #CONTENT# Tips"_qs << u"My Link"_qs << false << true << false
        << u"--pages|3|--links|10|--extension|HTML"_qs << QStringList{u"page1.HTML"_qs};
    QTest::newRow("lowercase caption, no index")
        << u"site_caption_lower"_qs << u"Garden Tips"_qs << u"My Link"_qs << true << false << true
        << u"--pages|2|--links|3|--template|plain.htm"_qs << QStringList{u"page1.htm"_qs, u"sitemap.htm"_qs};
}

void TestBatch::matchesSiteGoldenFiles()
{
    QFETCH(QString, golden);
    QFETCH(QString, title);
    QFETCH(QString, flags);
    QFETCH(QStringList, compared);

    // The options window saved these; the stored output folder is never used.
    QVERIFY(WriteTextFile(m_home + u"/templates/another.htm"_qs, u"#TITLE#"_qs));
    SiteOptions options = DefaultSiteOptions({u"another.htm"_qs, u"plain.htm"_qs});
    options.OutputFolder = u"/stored/folder"_qs;
    options.Template = u"plain.htm"_qs;
    options.TopCode = u"<b>Top ad</b>"_qs;
    options.LeftCode = u"<i>Left</i>"_qs;
    options.RightCode = u"Right & more"_qs;
    options.BottomCode = u"(c) 2026\r\nAll rights reserved"_qs;
    QFETCH(QString, caption);
    options.NavigationLinkName = caption;
    QFETCH(bool, lowercase);
    options.FileNamesSmallCase = lowercase;
    QFETCH(bool, index);
    options.CreateIndex = index;
    QFETCH(bool, sitemap);
    options.CreateSiteMap = sitemap;
    QVERIFY(!SaveConfig(m_home, options));
    const QByteArray config = ReadBytes(m_home + u"/config.txt"_qs);
    WriteWordFile(u"Garden"_qs, u"Yard"_qs);
    WriteWordFile(u"Plant"_qs, u"Sow, Seed"_qs);

    const BatchRun run = Run(Article(title, kSiteContents) + QStringList{u"--site"_qs, m_out} + Args(flags));
    QCOMPARE(run.Err, QByteArray());
    QCOMPARE(run.ExitCode, 0);
    const QString expectedFolder = kSiteData + u"/"_qs + golden;
    QCOMPARE(Files(m_out), Files(expectedFolder));
    for (const QString &file : compared)
        QVERIFY2(ReadBytes(m_out + u"/"_qs + file) == ReadBytes(expectedFolder + u"/"_qs + file), qPrintable(file));
    QCOMPARE(ReadBytes(m_home + u"/config.txt"_qs), config); // a batch run keeps the stored options
}

void TestBatch::writesArticleAsEntered_data()
{
    QTest::addColumn<QString>("title");
    QTest::addColumn<QString>("contents");
    QTest::addColumn<QString>("action"); // OUT stands for the output file, which exists already
    QTest::addColumn<QByteArray>("expected");
    QTest::newRow("text: T and C") << u"T"_qs << u"C"_qs << u"--text|OUT"_qs << QByteArray("T\r\n\r\nC ");
    QTest::newRow("text: blanks kept, line breaks as CR LF") << u"Hello, world "_qs << u"a\r\nb\rc\nd "_qs
                                                             << u"--text|OUT"_qs
                                                             << QByteArray("Hello, world\r\n\r\na\r\nb\r\nc\r\nd ");
    QTest::newRow("sql: the first statement has CR LF line breaks")
        << u"T"_qs << u"a\nb\rc"_qs << u"--sql|OUT|--table|t|--title-field|x|--article-field|y|--count|1"_qs
        << QByteArray("INSERT INTO t (x,y) VALUES (\"T \",\"a\r\nb\r\nc \");\r\n");
}

void TestBatch::writesArticleAsEntered()
{
    QFETCH(QString, title);
    QFETCH(QString, contents);
    QFETCH(QString, action);
    const QString output = m_out + u"/version"_qs;
    QVERIFY(WriteTextFile(output, u"an older and longer text"_qs));
    const BatchRun run = Run(Article(title, contents) + Args(action).replaceInStrings(u"OUT"_qs, output));
    QCOMPARE(run.Err, QByteArray());
    QCOMPARE(run.ExitCode, 0);
    QTEST(ReadBytes(output), "expected");
}

void TestBatch::followsTheRandomSequence_data()
{
    QTest::addColumn<QString>("seed");
    QTest::addColumn<quint32>("librarySeed");
    QTest::newRow("no seed: the never-seeded sequence") << QString() << quint32(std::mt19937::default_seed);
    QTest::newRow("seed 1") << u"--seed|1"_qs << quint32(1);
    QTest::newRow("seed 4294967295") << u"--seed|4294967295"_qs << quint32(4294967295u);
}

void TestBatch::followsTheRandomSequence()
{
    QFETCH(QString, seed);
    QFETCH(quint32, librarySeed);
    const QString title = u"Garden tips for busy people"_qs;
    const QString contents = u"Plant flowers early.\r\nWater flowers often, people say; gardens reward patience."_qs;
    for (const QString &word : {u"garden"_qs, u"tips"_qs, u"busy"_qs, u"people"_qs, u"plant"_qs, u"flowers"_qs,
                                u"early"_qs, u"water"_qs, u"often"_qs, u"gardens"_qs, u"reward"_qs, u"patience"_qs})
        WriteWordFile(word, word + u"A, "_qs + word + u"B, "_qs + word + u"C"_qs);

    // Two identical runs give identical files.
    const QStringList sql = Args(seed) + Args(u"--table|t|--title-field|title|--article-field|body|--count|25|"
                                              "--level|Maximum|--sql"_qs);
    QCOMPARE(Run(Article(title, contents) + sql + QStringList{Path(u"1.sql"_qs)}).ExitCode, 0);
    QCOMPARE(Run(Article(title, contents) + sql + QStringList{Path(u"2.sql"_qs)}).ExitCode, 0);
    const QByteArray output = ReadBytes(Path(u"1.sql"_qs));
    QCOMPARE(ReadBytes(Path(u"2.sql"_qs)), output);
    QCOMPARE(output.count("INSERT INTO"), 25);

    // The same bytes as the export window writes with that sequence.
    ArticleBoxes boxes{title + u" "_qs, contents + u" "_qs};
    const ArticleTokens article = SplitArticle(boxes.Title, boxes.Contents);
    const WordStore store(m_home);
    CachedWordFileAlternatives alternatives(store);
    MersenneRandomSource random(librarySeed);
    Spinner spinner(article, SpinSettings{WordTestSettings{}, 0}, alternatives, random);
    SpinnerVersionSource versions(spinner);
    const SqlExportOptions options{Path(u"library.sql"_qs), u"t"_qs, u"title"_qs, u"body"_qs, u"25"_qs};
    QCOMPARE(ExportSql(options, boxes, versions).Outcome, ExportResult::Status::Written);
    QCOMPARE(output, ReadBytes(options.FileName));
}

void TestBatch::listsNewWords_data()
{
    QTest::addColumn<QString>("settings");
    QTest::addColumn<QString>("expected");
    QTest::newRow("defaults") << QString() << u"Tips\nFlowers\nquickly\nbloom\n"_qs;
    QTest::newRow("ignored words, any case") << u"--ignore|FLOWERS|--ignore|tips"_qs << u"quickly\nbloom\n"_qs;
    QTest::newRow("ignore shorter 5") << u"--ignore-shorter|5"_qs << u"Flowers\nquickly\n"_qs;
    QTest::newRow("ignore shorter 2") << u"--ignore-shorter|2"_qs << u"Tips\nfor\nFlowers\nquickly\nsun\nbloom\n"_qs;
}

void TestBatch::listsNewWords()
{
    QFETCH(QString, settings);
    WriteWordFile(u"garden"_qs, u"yard"_qs);
    WriteWordFile(u"known"_qs, QString()); // a known word without alternatives
    const QMap<QString, QByteArray> before = Snapshot(m_home);
    // "Garden" has a file (names ignore case); numbers, "C#" and repeats are not listed again.
    const QString contents = u"Flowers quickly known, C# mp3 sun;\r\nflowers FLOWERS bloom."_qs;
    const BatchRun run = Run(Article(u"Garden Tips for 2024"_qs, contents) + Args(settings) + QStringList{u"--list-new"_qs});
    QCOMPARE(run.Err, QByteArray());
    QCOMPARE(run.ExitCode, 0);
    QTEST(QString::fromUtf8(run.Out), "expected");
    QCOMPARE(Snapshot(m_home), before); // without --lookup no word file is written
}

// ---------------------------------------------------------------------------------------------
// Bad input

void TestBatch::refusesBadInput_data()
{
    QTest::addColumn<QStringList>("arguments"); // after the home; OUT stands for the output folder
    QTest::addColumn<int>("exitCode");
    QTest::addColumn<QString>("message");       // the first line on stderr, after "verbloom-batch: "
    const auto row = [](const char *name, const QStringList &pieces, int exitCode, const QString &message) {
        QTest::newRow(name) << Args(pieces.join(u'|')) << exitCode << message;
    };
    const QString article = u"--title|Garden Tips|--contents-text|Plant early."_qs;
    const QString sql = u"--sql|OUT/x.sql|--table|t|--title-field|a|--article-field|b"_qs;
    const QString rss = u"--rss|OUT/x.xml|--url|http://x|--description-chars|50"_qs;
    const QString site = u"--site|OUT"_qs;
    const QString seed = u"--seed takes a whole number from 0 to 4294967295, not "_qs;

    // Usage errors.
    row("missing action", {article}, 2, u"no action: give one of --text, --sql, --rss, --site or --list-new"_qs);
    row("two actions", {article, sql, u"--list-new"_qs}, 2, u"one action at a time, not --sql and --list-new"_qs);
    row("unknown level", {article, u"--level|Level 4|--list-new"_qs}, 2,
        u"unknown level \"Level 4\": use Maximum, \"Level 3\", \"Level 2\", \"Level 1\" or Minimum"_qs);
    row("ignore shorter 6", {article, u"--ignore-shorter|6|--list-new"_qs}, 2,
        u"--ignore-shorter takes 2, 3, 4 or 5, not \"6\""_qs);
    row("negative seed", {article, u"--seed|-1|--list-new"_qs}, 2, seed + u"\"-1\""_qs);
    row("seed too large", {article, u"--seed|4294967296|--list-new"_qs}, 2, seed + u"\"4294967296\""_qs);
    row("seed beyond 64 bits", {article, u"--seed|99999999999999999999|--list-new"_qs}, 2,
        seed + u"\"99999999999999999999\""_qs);
    row("no title", {u"--contents-text|x|--list-new"_qs}, 2, u"--title is missing"_qs);
    row("two contents", {article, u"--contents|f|--list-new"_qs}, 2,
        u"--contents and --contents-text cannot be used together"_qs);
    row("title twice", {article, u"--title|x|--list-new"_qs}, 2, u"--title is given more than once"_qs);
    row("option of another action", {article, rss, u"--count|2|--table|t"_qs}, 2, u"--table is used only with --sql"_qs);
    row("required option", {article, u"--sql|OUT/x.sql|--table|t"_qs}, 2, u"--sql needs --title-field"_qs);
    row("unknown option", {article, u"--list-new|--colour"_qs}, 2, u"Unknown option 'colour'."_qs);
    row("stray argument", {article, u"--list-new|extra"_qs}, 2, u"unexpected argument \"extra\""_qs);

    // The main window's checks, in its order.
    row("blank title", {u"--title|   |--contents-text|x|--list-new"_qs}, 1, u"The title cannot be blank."_qs);
    row("both blank: the title first", {u"--title||--contents-text| |--list-new"_qs}, 1,
        u"The title cannot be blank."_qs);
    row("blank contents", {u"--title| a|--contents-text|  |--list-new"_qs}, 1, u"The contents cannot be blank."_qs);
    row("missing contents file", {u"--title|a|--contents|OUT/none.txt|--list-new"_qs}, 1,
        u"The contents file could not be read: OUT/none.txt"_qs);
    row("ignored word too short", {article, u"--ignore|seo|--list-new"_qs}, 1,
        u"Please make sure that the number of letters in ignore word is more than 3"_qs);

    // The export and site windows' checks (each message is tested with its window).
    row("sql count 0", {article, sql, u"--count|0"_qs}, 1, u"No of article to insert should be between 1 and 32767"_qs);
    row("sql count 32768", {article, sql, u"--count|32768"_qs}, 1,
        u"No of article to insert should be between 1 and 32767"_qs);
    row("sql empty table", {article, u"--sql|OUT/x.sql|--table||--title-field|a|--article-field|b"_qs}, 1,
        u"Please enter Table name"_qs);
    row("rss count 0", {article, rss, u"--count|0"_qs}, 1, u"No of record should be between 1 and 32767"_qs);
    row("rss count 40000", {article, rss, u"--count|40000"_qs}, 1, u"No of record should not be more than 32767"_qs);
    row("rss empty url", {article, u"--rss|OUT/x.xml|--url||--count|2|--description-chars|5"_qs}, 1,
        u"Please enter url"_qs);
    row("site pages 32768", {article, site, u"--pages|32768"_qs}, 1,
        u"Number of pages to generate should be between 0 and 32767"_qs);
    row("site folder missing", {article, u"--site|OUT/none"_qs}, 1, u"Output folder does't exist"_qs);
    row("site unknown template", {article, site, u"--template|none.htm"_qs}, 1,
        u"The template \"none.htm\" is not in the folder HOME/templates"_qs);

    // Output that cannot be written.
    row("sql into a missing folder", {article, u"--sql|OUT/no/x.sql|--table|t|--title-field|a|--article-field|b"_qs},
        1, u"File could not be saved as OUT/no/x.sql"_qs);
    row("rss into a missing folder", {article, u"--rss|OUT/no/x.xml|--url|u|--count|1|--description-chars|9"_qs}, 1,
        u"File could not be saved as OUT/no/x.xml"_qs);
    row("text over a folder", {article, u"--text|OUT"_qs}, 1, u"File could not be saved as OUT"_qs);
}

void TestBatch::refusesBadInput()
{
    QFETCH(QStringList, arguments);
    QFETCH(int, exitCode);
    QFETCH(QString, message);
    arguments.replaceInStrings(u"OUT"_qs, m_out);
    message.replace(u"OUT"_qs, m_out).replace(u"HOME"_qs, m_home);
    const QMap<QString, QByteArray> before = Snapshot(m_dir->path());

    const BatchRun run = Run(QStringList{u"--home"_qs, m_home} + arguments);
    QCOMPARE(run.ExitCode, exitCode);
    const QStringList lines = QString::fromUtf8(run.Err).split(QLatin1Char('\n'));
    QCOMPARE(lines.first(), u"verbloom-batch: "_qs + message);
    QCOMPARE(lines.contains(u"Try 'verbloom-batch --help' for more information."_qs), exitCode == 2);
    QCOMPARE(run.Out, QByteArray());
    QCOMPARE(Snapshot(m_dir->path()), before); // nothing written, no data folder made
}

void TestBatch::refusesBadDateEpoch()
{
    const QStringList arguments = Article(u"T"_qs, u"C"_qs)
        + Args(u"--rss|"_qs + m_out + u"/feed.xml|--url|u|--count|1|--description-chars|9"_qs);
    const BatchRun run = Run(arguments, {{u"SOURCE_DATE_EPOCH"_qs, u"yesterday"_qs}});
    QCOMPARE(run.ExitCode, 2);
    QVERIFY(run.Err.startsWith("verbloom-batch: SOURCE_DATE_EPOCH must be a number of seconds since "
                               "1970-01-01 00:00 UTC, not \"yesterday\"\n"));
    QVERIFY(Files(m_out).isEmpty());
    // An empty value counts as not set.
    QCOMPARE(Run(arguments, {{u"SOURCE_DATE_EPOCH"_qs, QString()}}).ExitCode, 0);
    QVERIFY(ReadTextFile(m_out + u"/feed.xml"_qs).contains(u"<pubDate>"_qs));
}

void TestBatch::siteAsksForForceOverExistingIndex()
{
    QVERIFY(WriteTextFile(m_out + u"/index.htm"_qs, u"old index"_qs));
    const QStringList arguments = Article(u"Garden Tips"_qs, kSiteContents) + QStringList{u"--site"_qs, m_out}
        + Args(u"--pages|2"_qs);
    const QMap<QString, QByteArray> before = Snapshot(m_dir->path());
    BatchRun run = Run(arguments);
    QCOMPARE(run.ExitCode, 1);
    QCOMPARE(QString::fromUtf8(run.Err), u"verbloom-batch: File already exist: "_qs + m_out
                                             + u"/index.htm (add --force to write the site over it)\n"_qs);
    QCOMPARE(Snapshot(m_dir->path()), before);

    run = Run(arguments + QStringList{u"--force"_qs});
    QCOMPARE(run.Err, QByteArray());
    QCOMPARE(run.ExitCode, 0);
    QCOMPARE(Files(m_out), (QStringList{u"index.htm"_qs, u"page1.htm"_qs, u"page2.htm"_qs, u"sitemap.htm"_qs}));
    QCOMPARE(ReadBytes(m_out + u"/index.htm"_qs), ReadBytes(m_out + u"/page2.htm"_qs));
    QVERIFY(!QFileInfo::exists(m_home + u"/config.txt"_qs)); // the defaults were used, nothing saved
}

void TestBatch::reportsSiteFilesThatFail()
{
    QVERIFY(QDir().mkpath(m_out + u"/page2.htm"_qs)); // a folder where a page should go
    const BatchRun run = Run(Article(u"Garden Tips"_qs, kSiteContents) + QStringList{u"--site"_qs, m_out}
                             + Args(u"--pages|3"_qs));
    QCOMPARE(run.ExitCode, 1);
    QCOMPARE(QString::fromUtf8(run.Err),
             u"verbloom-batch: 1 of 5 files could not be written:\n"_qs + m_out + u"/page2.htm\n"_qs);
    QVERIFY(QFileInfo(m_out + u"/page3.htm"_qs).isFile());
}

// ---------------------------------------------------------------------------------------------
// Lookups

void TestBatch::lookupWritesWordFiles()
{
    const QString data = Path(u"th_small"_qs);
    QVERIFY(WriteThesaurus(data, {{u"bloom"_qs, {u"(verb)|blossom|flower"_qs}},
                                  {u"garden"_qs, {u"(noun)|yard|backyard"_qs, u"(verb)|cultivate|grow"_qs}},
                                  {u"quickly"_qs, {u"(adv)|rapidly|speedily|fast"_qs}}}));
    ThesaurusService service;
    QVERIFY2(service.Start(data), qPrintable(service.ErrorString()));
    QVERIFY(WriteTextFile(m_home + u"/SETTINGS.INI"_qs, u"[URL]\r\nThesaurusUrl="_qs + service.BaseUrl() + u"\r\n"_qs));
    WriteWordFile(u"plant"_qs, u"sow, seed"_qs);

    const QStringList arguments = Article(u"Garden Tips"_qs, u"Plant flowers. Flowers bloom quickly; garden."_qs);
    BatchRun run = Run(arguments + QStringList{u"--lookup"_qs, u"--list-new"_qs});
    QCOMPARE(run.Err, QByteArray());
    QCOMPARE(run.ExitCode, 0);
    QCOMPARE(QString::fromUtf8(run.Out), u"Garden\nTips\nflowers\nbloom\nquickly\n"_qs);

    // "Manual": the last meaning's synonyms; a word without entry is known without alternatives;
    // "plant" keeps its file and is not looked up.
    const QMap<QString, QByteArray> wordFiles{{u"bloom.dat"_qs, "blossom, flower"}, {u"flowers.dat"_qs, ""},
                                              {u"garden.dat"_qs, "cultivate, grow"}, {u"plant.dat"_qs, "sow, seed"},
                                              {u"quickly.dat"_qs, "rapidly, speedily, fast"}, {u"tips.dat"_qs, ""}};
    QCOMPARE(Snapshot(m_home + u"/data"_qs), wordFiles);

    // The next run finds every word, and the versions draw from the alternatives written.
    run = Run(arguments + QStringList{u"--list-new"_qs});
    QCOMPARE(run.ExitCode, 0);
    QCOMPARE(run.Out, QByteArray());
    const QString output = m_out + u"/garden.txt"_qs;
    run = Run(Article(u"Garden"_qs, u"Garden garden garden garden garden garden."_qs)
              + Args(u"--level|Maximum|--text|"_qs + output));
    QCOMPARE(run.ExitCode, 0);
    const QString version = ReadTextFile(output);
    QVERIFY2(version.contains(u"cultivate"_qs, Qt::CaseInsensitive) || version.contains(u"grow"_qs, Qt::CaseInsensitive),
             qPrintable(version));
}

void TestBatch::lookupUsesEmbeddedThesaurus()
{
    if (!QFile::exists(ThesaurusService::DefaultDataPath() + u".idx"_qs))
        QSKIP("The thesaurus data of the package mythes-en-us is not installed");
    // No SETTINGS.INI: the thesaurus built into the program answers.
    const BatchRun run = Run(Article(u"Happy"_qs, u"Happy gardeners."_qs) + Args(u"--lookup|--list-new"_qs));
    QCOMPARE(run.Err, QByteArray());
    QCOMPARE(run.ExitCode, 0);
    QCOMPARE(run.Out, QByteArray("Happy\ngardeners\n"));
    QVERIFY(!ReadTextFile(m_home + u"/data/happy.dat"_qs).isEmpty());
    QVERIFY(QFileInfo(m_home + u"/data/gardeners.dat"_qs).isFile());
}

void TestBatch::reportsWordFilesThatCannotBeWritten()
{
    ThesaurusService service;
    QVERIFY(service.StartWithoutData());
    QVERIFY(WriteTextFile(m_home + u"/SETTINGS.INI"_qs, u"[URL]\r\nThesaurusUrl="_qs + service.BaseUrl()));
    QVERIFY(WriteTextFile(m_home + u"/data"_qs, QString())); // a file where the word files should go
    const QString output = m_out + u"/version.txt"_qs;
    const BatchRun run = Run(Article(u"Garden Tips"_qs, u"Plant flowers."_qs) + Args(u"--lookup|--text|"_qs + output));
    QCOMPARE(run.ExitCode, 1);
    QCOMPARE(QString::fromUtf8(run.Err), u"verbloom-batch: The alternatives of 4 word(s) could not be saved in "
                                         "the folder \""_qs + m_home + u"/data\".\n"_qs);
    QVERIFY(!QFileInfo::exists(output)); // the versions would lack the words' alternatives
}

void TestBatch::helpDocumentsEveryOption()
{
    const BatchRun run = Run({u"--help"_qs});
    QCOMPARE(run.ExitCode, 0);
    QCOMPARE(run.Err, QByteArray());
    const QString help = QString::fromUtf8(run.Out);
    const QStringList options = Args(u"--home|--title|--contents |--contents-text|--level|--ignore-shorter|--ignore |"
                                     "--lookup|--seed|--text|--sql|--table|--title-field|--article-field|--count|--rss|"
                                     "--url|--description-chars|--site|--pages|--links|--template|--extension|--force|"
                                     "--list-new|SOURCE_DATE_EPOCH|Exit status"_qs);
    for (const QString &option : options)
        QVERIFY2(help.contains(option), qPrintable(option));
}

QTEST_GUILESS_MAIN(TestBatch)
#include "tst_batch.moc"
