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

// Every file and folder below `root` with its bytes, to show that a run wrote nothing.
QMap<QString, QByteArray> Snapshot(const QString &root)
{
    QMap<QString, QByteArray> tree;
    QDirIterator it(root, QDir::AllEntries | QDir::NoDotAndDotDot | QDir::Hidden, QDirIterator::Subdirectories);
    while (it.hasNext()) {
        const QString path = it.next();
        tree.insert(path, it.fileInfo().isDir() ? QByteArray("<dir>") : ReadBytes(path));
    }
    return tree;
}

QStringList Files(const QString &folder)
{
    return QDir(folder).entryList(QDir::Files, QDir::Name);
}

// The first statement of an SQL file: up to and including its first ");" CR LF.
QByteArray FirstStatement(const QByteArray &sql)
{
    const qsizetype end = sql.indexOf(");\r\n");
    return end < 0 ? sql : sql.left(end + 4);
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
    void writesTextLayout_data();
    void writesTextLayout();
    void firstStatementHasCrLfLineBreaks();

    void repeatsTheSequenceWithoutSeed_data();
    void repeatsTheSequenceWithoutSeed();
    void seedsStartOtherSequences();

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
    void WriteWordFile(const QString &word, const QString &alternatives);
    QString Path(const QString &name) const { return m_dir->filePath(name); }
    // The bytes the export writers make from the analysed article with the given random source:
    // what the windows would write.
    QByteArray LibrarySql(const QString &title, const QString &contents, int level, int count,
                          RandomSource &random);

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

void TestBatch::WriteWordFile(const QString &word, const QString &alternatives)
{
    QVERIFY(WordStore(m_home).WriteAlternatives(word, alternatives));
}

QByteArray TestBatch::LibrarySql(const QString &title, const QString &contents, int level, int count,
                                 RandomSource &random)
{
    ArticleBoxes boxes{title + u" "_qs, contents + u" "_qs};
    const ArticleTokens article = SplitArticle(boxes.Title, boxes.Contents);
    const WordStore store(m_home);
    CachedWordFileAlternatives alternatives(store);
    Spinner spinner(article, SpinSettings{WordTestSettings{}, level}, alternatives, random);
    SpinnerVersionSource versions(spinner);
    SqlExportOptions options{Path(u"library.sql"_qs), u"t"_qs, u"title"_qs, u"body"_qs, QString::number(count)};
    if (ExportSql(options, boxes, versions).Outcome != ExportResult::Status::Written)
        return {};
    return ReadBytes(options.FileName);
}

// ---------------------------------------------------------------------------------------------
// Golden files of the export and site writers

void TestBatch::matchesExportGoldenFiles_data()
{
    QTest::addColumn<QString>("golden");
    QTest::addColumn<QStringList>("action"); // OUT stands for the output file
    QTest::addColumn<bool>("firstStatementOnly");

    QTest::newRow("sql_count1.sql") << u"sql_count1.sql"_qs
                                    << QStringList{u"--sql"_qs, u"OUT"_qs, u"--table"_qs, u"articles"_qs,
                                                   u"--title-field"_qs, u"title"_qs, u"--article-field"_qs,
                                                   u"body"_qs, u"--count"_qs, u"1"_qs}
                                    << false;
    QTest::newRow("sql_count3_5.sql, first statement, quoted field")
        << u"sql_count3_5.sql"_qs
        << QStringList{u"--sql"_qs, u"OUT"_qs, u"--table"_qs, u"my table"_qs, u"--title-field"_qs, u"title"_qs,
                       u"--article-field"_qs, u"body\"text\""_qs, u"--count"_qs, u"1"_qs}
        << true;
    QTest::newRow("rss_1item.xml") << u"rss_1item.xml"_qs
                                   << QStringList{u"--rss"_qs, u"OUT"_qs, u"--url"_qs,
                                                  u"http://example.com/feed?a=1&b=2"_qs, u"--count"_qs, u" 1 "_qs,
                                                  u"--description-chars"_qs, u"100"_qs}
                                   << false;
}

void TestBatch::matchesExportGoldenFiles()
{
    QFETCH(QString, golden);
    QFETCH(QStringList, action);
    QFETCH(bool, firstStatementOnly);

    // Alternatives for every word: the first version is the article as entered all the same.
    for (const QString &word : {u"Spring"_qs, u"Garden"_qs, u"Tips"_qs, u"Tricks"_qs, u"Plant"_qs, u"early"_qs,
                                u"Water"_qs, u"often"_qs, u"well"_qs, u"done"_qs})
        WriteWordFile(word, u"alpha, beta"_qs);
    const QString output = m_out + u"/"_qs + golden;
    action.replaceInStrings(u"OUT"_qs, output);
    const BatchRun run = Run(Article(kExportTitle, kExportContents) + QStringList{u"--level"_qs, u"Maximum"_qs}
                                 + action,
                             {{u"SOURCE_DATE_EPOCH"_qs, kGoldenEpoch}, {u"TZ"_qs, kUtcPlusOne}});
    QCOMPARE(run.Err, QByteArray());
    QCOMPARE(run.ExitCode, 0);
    QCOMPARE(run.Out, QByteArray());
    const QByteArray expected = ReadBytes(kExportData + u"/"_qs + golden);
    QVERIFY(!expected.isEmpty());
    QCOMPARE(ReadBytes(output), firstStatementOnly ? FirstStatement(expected) : expected);
}

void TestBatch::matchesSiteGoldenFiles_data()
{
    QTest::addColumn<QString>("golden");
    QTest::addColumn<QString>("title");
    QTest::addColumn<QString>("caption");
    QTest::addColumn<bool>("lowercase");
    QTest::addColumn<bool>("index");
    QTest::addColumn<bool>("sitemap");
    QTest::addColumn<QStringList>("flags");
    QTest::addColumn<QStringList>("compared"); // files whose every byte can be reproduced

    // Pages 2 onward carry customized versions, which the golden files do not hold; page 1 carries
    // the article as entered, and the site map only names the pages.
    QTest::newRow("0 pages") << u"site_0pages"_qs << u"Garden Tips"_qs << u"Link"_qs << true << true << true
                             << QStringList{u"--pages"_qs, u"0"_qs}
                             << QStringList{u"index.htm"_qs, u"sitemap.htm"_qs};
    QTest::newRow("25 x 10, options of config.txt")
        << u"site_25x10"_qs << u"Garden Tips"_qs << u"Link"_qs << true << true << true << QStringList{}
        << QStringList{u"page1.htm"_qs, u"sitemap.htm"_qs};
    QTest::newRow("3 x 10, cleaned caption, extension flag")
        << u"site_3x10"_qs << u"Garden #CONTENT# Tips"_qs << u"My Link"_qs << false << true << false
        << QStringList{u"--pages"_qs, u"3"_qs, u"--links"_qs, u"10"_qs, u"--extension"_qs, u"HTML"_qs}
        << QStringList{u"page1.HTML"_qs};
    QTest::newRow("lowercase caption, no index")
        << u"site_caption_lower"_qs << u"Garden Tips"_qs << u"My Link"_qs << true << false << true
        << QStringList{u"--pages"_qs, u"2"_qs, u"--links"_qs, u"3"_qs, u"--template"_qs, u"plain.htm"_qs}
        << QStringList{u"page1.htm"_qs, u"sitemap.htm"_qs};
}

void TestBatch::matchesSiteGoldenFiles()
{
    QFETCH(QString, golden);
    QFETCH(QString, title);
    QFETCH(QString, caption);
    QFETCH(bool, lowercase);
    QFETCH(bool, index);
    QFETCH(bool, sitemap);
    QFETCH(QStringList, flags);
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
    options.NavigationLinkName = caption;
    options.FileNamesSmallCase = lowercase;
    options.CreateIndex = index;
    options.CreateSiteMap = sitemap;
    QVERIFY(!SaveConfig(m_home, options));
    const QByteArray config = ReadBytes(m_home + u"/config.txt"_qs);
    WriteWordFile(u"Garden"_qs, u"Yard"_qs);
    WriteWordFile(u"Plant"_qs, u"Sow, Seed"_qs);

    const BatchRun run = Run(Article(title, kSiteContents) + QStringList{u"--site"_qs, m_out} + flags);
    QCOMPARE(run.Err, QByteArray());
    QCOMPARE(run.ExitCode, 0);
    const QString expectedFolder = kSiteData + u"/"_qs + golden;
    QCOMPARE(Files(m_out), Files(expectedFolder));
    for (const QString &file : compared)
        QVERIFY2(ReadBytes(m_out + u"/"_qs + file) == ReadBytes(expectedFolder + u"/"_qs + file), qPrintable(file));
    QCOMPARE(ReadBytes(m_home + u"/config.txt"_qs), config); // a batch run keeps the stored options
}

void TestBatch::writesTextLayout_data()
{
    QTest::addColumn<QString>("title");
    QTest::addColumn<QString>("contents");
    QTest::addColumn<QByteArray>("expected");
    QTest::newRow("T and C") << u"T"_qs << u"C"_qs << QByteArray("T\r\n\r\nC ");
    QTest::newRow("blanks kept, line breaks as CR LF")
        << u"Hello, world "_qs << u"a\r\nb\rc\nd "_qs << QByteArray("Hello, world\r\n\r\na\r\nb\r\nc\r\nd ");
    QTest::newRow("ends with a line break") << u"x"_qs << u"end\r\n"_qs << QByteArray("x\r\n\r\nend\r\n ");
}

void TestBatch::writesTextLayout()
{
    QFETCH(QString, title);
    QFETCH(QString, contents);
    QFETCH(QByteArray, expected);
    const QString output = m_out + u"/version.txt"_qs;
    QVERIFY(WriteTextFile(output, u"older text"_qs));
    const BatchRun run = Run(Article(title, contents) + QStringList{u"--text"_qs, output});
    QCOMPARE(run.Err, QByteArray());
    QCOMPARE(run.ExitCode, 0);
    QCOMPARE(ReadBytes(output), expected);
}

void TestBatch::firstStatementHasCrLfLineBreaks()
{
    const QString output = m_out + u"/lines.sql"_qs;
    const BatchRun run = Run(Article(u"T"_qs, u"a\nb\rc"_qs)
                             + QStringList{u"--sql"_qs, output, u"--table"_qs, u"t"_qs, u"--title-field"_qs,
                                           u"x"_qs, u"--article-field"_qs, u"y"_qs, u"--count"_qs, u"1"_qs});
    QCOMPARE(run.ExitCode, 0);
    QCOMPARE(ReadBytes(output), QByteArray("INSERT INTO t (x,y) VALUES (\"T \",\"a\r\nb\r\nc \");\r\n"));
}

// ---------------------------------------------------------------------------------------------
// Random draws

void TestBatch::repeatsTheSequenceWithoutSeed_data()
{
    QTest::addColumn<QStringList>("seed");
    QTest::addColumn<quint32>("librarySeed");
    QTest::newRow("no seed: the never-seeded sequence") << QStringList{} << quint32(std::mt19937::default_seed);
    QTest::newRow("seed 1") << QStringList{u"--seed"_qs, u"1"_qs} << quint32(1);
    QTest::newRow("seed 4294967295") << QStringList{u"--seed"_qs, u"4294967295"_qs} << quint32(4294967295u);
}

void TestBatch::repeatsTheSequenceWithoutSeed()
{
    QFETCH(QStringList, seed);
    QFETCH(quint32, librarySeed);
    const QString title = u"Garden tips for busy people"_qs;
    const QString contents = u"Plant flowers early.\r\nWater flowers often, people say; gardens reward patience."_qs;
    for (const QString &word : {u"garden"_qs, u"tips"_qs, u"busy"_qs, u"people"_qs, u"plant"_qs, u"flowers"_qs,
                                u"early"_qs, u"water"_qs, u"often"_qs, u"gardens"_qs, u"reward"_qs, u"patience"_qs})
        WriteWordFile(word, word + u"A, "_qs + word + u"B, "_qs + word + u"C"_qs);

    const QStringList sql{u"--table"_qs, u"t"_qs, u"--title-field"_qs, u"title"_qs, u"--article-field"_qs,
                          u"body"_qs, u"--count"_qs, u"25"_qs, u"--level"_qs, u"Maximum"_qs};
    const QStringList first = Article(title, contents) + seed + sql + QStringList{u"--sql"_qs, Path(u"1.sql"_qs)};
    const QStringList second = Article(title, contents) + seed + sql + QStringList{u"--sql"_qs, Path(u"2.sql"_qs)};
    QCOMPARE(Run(first).ExitCode, 0);
    QCOMPARE(Run(second).ExitCode, 0);
    const QByteArray output = ReadBytes(Path(u"1.sql"_qs));
    QCOMPARE(ReadBytes(Path(u"2.sql"_qs)), output);
    // The same bytes as the export window would write with that sequence.
    MersenneRandomSource random(librarySeed);
    QCOMPARE(output, LibrarySql(title, contents, 0, 25, random));
    QCOMPARE(output.count("INSERT INTO"), 25);
}

void TestBatch::seedsStartOtherSequences()
{
    WriteWordFile(u"garden"_qs, u"yard, park, plot, field"_qs);
    WriteWordFile(u"flowers"_qs, u"blooms, blossoms, petals"_qs);
    const QStringList base = Article(u"Garden"_qs, u"Flowers flowers flowers garden garden garden."_qs)
        + QStringList{u"--level"_qs, u"Maximum"_qs, u"--table"_qs, u"t"_qs, u"--title-field"_qs, u"a"_qs,
                      u"--article-field"_qs, u"b"_qs, u"--count"_qs, u"8"_qs};
    QMap<QString, QByteArray> outputs;
    for (const QString &seed : {u""_qs, u"1"_qs, u"2"_qs, u"5489"_qs}) {
        const QString path = Path(u"seed"_qs + seed + u".sql"_qs);
        QStringList arguments = base + QStringList{u"--sql"_qs, path};
        if (!seed.isEmpty())
            arguments << u"--seed"_qs << seed;
        QCOMPARE(Run(arguments).ExitCode, 0);
        outputs.insert(seed, ReadBytes(path));
    }
    QVERIFY(outputs[u""_qs] != outputs[u"1"_qs]);
    QVERIFY(outputs[u"1"_qs] != outputs[u"2"_qs]);
    // The never-seeded sequence is the generator's default start.
    QCOMPARE(outputs[u"5489"_qs], outputs[u""_qs]);
}

// ---------------------------------------------------------------------------------------------
// --list-new

void TestBatch::listsNewWords_data()
{
    QTest::addColumn<QStringList>("settings");
    QTest::addColumn<QString>("expected");
    QTest::newRow("defaults") << QStringList{} << u"Tips\nFlowers\nquickly\nbloom\n"_qs;
    QTest::newRow("ignored words, any case")
        << QStringList{u"--ignore"_qs, u"FLOWERS"_qs, u"--ignore"_qs, u"tips"_qs} << u"quickly\nbloom\n"_qs;
    QTest::newRow("ignore shorter 5") << QStringList{u"--ignore-shorter"_qs, u"5"_qs} << u"Flowers\nquickly\n"_qs;
    QTest::newRow("ignore shorter 2") << QStringList{u"--ignore-shorter"_qs, u"2"_qs}
                                      << u"Tips\nfor\nFlowers\nquickly\nsun\nbloom\n"_qs;
}

void TestBatch::listsNewWords()
{
    QFETCH(QStringList, settings);
    QFETCH(QString, expected);
    WriteWordFile(u"garden"_qs, u"yard"_qs);
    WriteWordFile(u"known"_qs, QString()); // a known word without alternatives
    const QMap<QString, QByteArray> before = Snapshot(m_home);
    // "Garden" has a file (names ignore case); numbers, "C#" and repeats are not listed again.
    const BatchRun run = Run(Article(u"Garden Tips for 2024"_qs,
                                     u"Flowers quickly known, C# mp3 sun;\r\nflowers FLOWERS bloom."_qs)
                             + settings + QStringList{u"--list-new"_qs});
    QCOMPARE(run.Err, QByteArray());
    QCOMPARE(run.ExitCode, 0);
    QCOMPARE(QString::fromUtf8(run.Out), expected);
    QCOMPARE(Snapshot(m_home), before); // without --lookup no word file is written
}

// ---------------------------------------------------------------------------------------------
// Bad input

void TestBatch::refusesBadInput_data()
{
    QTest::addColumn<QStringList>("arguments"); // after the home; OUT stands for the output folder
    QTest::addColumn<int>("exitCode");
    QTest::addColumn<QString>("message");       // the first line on stderr, after "verbloom-batch: "

    const QStringList article{u"--title"_qs, u"Garden Tips"_qs, u"--contents-text"_qs, u"Plant early."_qs};
    const QStringList sql{u"--table"_qs, u"t"_qs, u"--title-field"_qs, u"a"_qs, u"--article-field"_qs, u"b"_qs};
    const QStringList sqlTo = QStringList{u"--sql"_qs, u"OUT/x.sql"_qs} + sql;
    const QStringList rss{u"--rss"_qs, u"OUT/x.xml"_qs, u"--url"_qs, u"http://x"_qs, u"--description-chars"_qs,
                          u"50"_qs};
    const QStringList site{u"--site"_qs, u"OUT"_qs};

    // Usage errors.
    QTest::newRow("missing action") << article << 2
                                    << u"no action: give one of --text, --sql, --rss, --site or --list-new"_qs;
    QTest::newRow("two actions") << article + sqlTo + QStringList{u"--list-new"_qs} << 2
                                 << u"one action at a time, not --sql and --list-new"_qs;
    QTest::newRow("unknown level") << article + QStringList{u"--level"_qs, u"Level 4"_qs, u"--list-new"_qs} << 2
                                   << u"unknown level \"Level 4\": use Maximum, \"Level 3\", \"Level 2\", "
                                      "\"Level 1\" or Minimum"_qs;
    QTest::newRow("ignore shorter 6") << article + QStringList{u"--ignore-shorter"_qs, u"6"_qs, u"--list-new"_qs}
                                      << 2 << u"--ignore-shorter takes 2, 3, 4 or 5, not \"6\""_qs;
    QTest::newRow("negative seed") << article + QStringList{u"--seed"_qs, u"-1"_qs, u"--list-new"_qs} << 2
                                   << u"--seed takes a whole number from 0 to 4294967295, not \"-1\""_qs;
    QTest::newRow("seed too large") << article + QStringList{u"--seed"_qs, u"4294967296"_qs, u"--list-new"_qs}
                                    << 2 << u"--seed takes a whole number from 0 to 4294967295, not \"4294967296\""_qs;
    QTest::newRow("seed beyond 64 bits") << article + QStringList{u"--seed"_qs, u"99999999999999999999"_qs,
                                                                  u"--list-new"_qs}
                                         << 2
                                         << u"--seed takes a whole number from 0 to 4294967295, not "
                                            "\"99999999999999999999\""_qs;
    QTest::newRow("no title") << QStringList{u"--contents-text"_qs, u"x"_qs, u"--list-new"_qs} << 2
                              << u"--title is missing"_qs;
    QTest::newRow("two contents") << article + QStringList{u"--contents"_qs, u"f"_qs, u"--list-new"_qs} << 2
                                  << u"--contents and --contents-text cannot be used together"_qs;
    QTest::newRow("title twice") << article + QStringList{u"--title"_qs, u"x"_qs, u"--list-new"_qs} << 2
                                 << u"--title is given more than once"_qs;
    QTest::newRow("option of another action") << article + rss + QStringList{u"--count"_qs, u"2"_qs,
                                                                             u"--table"_qs, u"t"_qs}
                                              << 2 << u"--table is used only with --sql"_qs;
    QTest::newRow("required option") << article + QStringList{u"--sql"_qs, u"OUT/x.sql"_qs, u"--table"_qs, u"t"_qs}
                                     << 2 << u"--sql needs --title-field"_qs;
    QTest::newRow("unknown option") << article + QStringList{u"--list-new"_qs, u"--colour"_qs} << 2
                                    << u"Unknown option 'colour'."_qs;
    QTest::newRow("stray argument") << article + QStringList{u"--list-new"_qs, u"extra"_qs} << 2
                                    << u"unexpected argument \"extra\""_qs;

    // The main window's checks, in its order.
    QTest::newRow("blank title") << QStringList{u"--title"_qs, u"   "_qs, u"--contents-text"_qs, u"x"_qs,
                                                u"--list-new"_qs}
                                 << 1 << u"The title cannot be blank."_qs;
    QTest::newRow("both blank: the title first") << QStringList{u"--title"_qs, u""_qs, u"--contents-text"_qs,
                                                                u" "_qs, u"--list-new"_qs}
                                                 << 1 << u"The title cannot be blank."_qs;
    QTest::newRow("blank contents") << QStringList{u"--title"_qs, u" a"_qs, u"--contents-text"_qs, u"  "_qs,
                                                   u"--list-new"_qs}
                                    << 1 << u"The contents cannot be blank."_qs;
    QTest::newRow("missing contents file") << QStringList{u"--title"_qs, u"a"_qs, u"--contents"_qs,
                                                          u"OUT/none.txt"_qs, u"--list-new"_qs}
                                           << 1 << u"The contents file could not be read: OUT/none.txt"_qs;
    QTest::newRow("ignored word too short") << article + QStringList{u"--ignore"_qs, u"seo"_qs, u"--list-new"_qs}
                                            << 1
                                            << u"Please make sure that the number of letters in ignore word is "
                                               "more than 3"_qs;
    QTest::newRow("ignored word with two marks") << article + QStringList{u"--ignore"_qs, u"a.b,cd"_qs,
                                                                          u"--list-new"_qs}
                                                 << 1 << u"Please make sure that the letter \",\" is NOT there in "
                                                         "your word"_qs;

    // The export windows' checks.
    QTest::newRow("sql count 0") << article + sqlTo + QStringList{u"--count"_qs, u"0"_qs} << 1
                                 << u"No of article to insert should be between 1 and 32767"_qs;
    QTest::newRow("sql count 32768") << article + sqlTo + QStringList{u"--count"_qs, u"32768"_qs} << 1
                                     << u"No of article to insert should be between 1 and 32767"_qs;
    QTest::newRow("sql count word") << article + sqlTo + QStringList{u"--count"_qs, u"ten"_qs} << 1
                                    << u"No of article to insert should be numeric"_qs;
    QTest::newRow("sql empty table") << article + QStringList{u"--sql"_qs, u"OUT/x.sql"_qs, u"--table"_qs, u""_qs,
                                                              u"--title-field"_qs, u"a"_qs, u"--article-field"_qs,
                                                              u"b"_qs}
                                     << 1 << u"Please enter Table name"_qs;
    QTest::newRow("rss count 0") << article + rss + QStringList{u"--count"_qs, u"0"_qs} << 1
                                 << u"No of record should be between 1 and 32767"_qs;
    QTest::newRow("rss count 40000") << article + rss + QStringList{u"--count"_qs, u"40000"_qs} << 1
                                     << u"No of record should not be more than 32767"_qs;
    QTest::newRow("rss empty url") << article + QStringList{u"--rss"_qs, u"OUT/x.xml"_qs, u"--url"_qs, u""_qs,
                                                            u"--count"_qs, u"2"_qs, u"--description-chars"_qs,
                                                            u"5"_qs}
                                   << 1 << u"Please enter url"_qs;
    QTest::newRow("rss characters word") << article + QStringList{u"--rss"_qs, u"OUT/x.xml"_qs, u"--url"_qs,
                                                                  u"u"_qs, u"--count"_qs, u"2"_qs,
                                                                  u"--description-chars"_qs, u"many"_qs}
                                         << 1 << u"no of character for description should be numeric"_qs;

    // The site options window's checks.
    QTest::newRow("site pages 32768") << article + site + QStringList{u"--pages"_qs, u"32768"_qs} << 1
                                      << u"Number of pages to generate should be between 0 and 32767"_qs;
    QTest::newRow("site links word") << article + site + QStringList{u"--links"_qs, u"ten"_qs} << 1
                                     << u"Number of links in menu per page should be numeric"_qs;
    QTest::newRow("site empty extension") << article + site + QStringList{u"--extension"_qs, u""_qs} << 1
                                          << u"Please enter the file extension"_qs;
    QTest::newRow("site folder missing") << article + QStringList{u"--site"_qs, u"OUT/none"_qs} << 1
                                         << u"Output folder does't exist"_qs;
    QTest::newRow("site unknown template") << article + site + QStringList{u"--template"_qs, u"none.htm"_qs} << 1
                                           << u"The template \"none.htm\" is not in the folder HOME/templates"_qs;

    // Output that cannot be written.
    QTest::newRow("sql into a missing folder") << article + QStringList{u"--sql"_qs, u"OUT/no/x.sql"_qs} + sql << 1
                                               << u"File could not be saved as OUT/no/x.sql"_qs;
    QTest::newRow("rss into a missing folder") << article + QStringList{u"--rss"_qs, u"OUT/no/x.xml"_qs,
                                                                        u"--url"_qs, u"u"_qs, u"--count"_qs, u"1"_qs,
                                                                        u"--description-chars"_qs, u"9"_qs}
                                               << 1 << u"File could not be saved as OUT/no/x.xml"_qs;
    QTest::newRow("text over a folder") << article + QStringList{u"--text"_qs, u"OUT"_qs} << 1
                                        << u"File could not be saved as OUT"_qs;
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
        + QStringList{u"--rss"_qs, m_out + u"/feed.xml"_qs, u"--url"_qs, u"u"_qs, u"--count"_qs, u"1"_qs,
                      u"--description-chars"_qs, u"9"_qs};
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
    const QStringList arguments = Article(u"Garden Tips"_qs, kSiteContents)
        + QStringList{u"--site"_qs, m_out, u"--pages"_qs, u"2"_qs};
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
    const BatchRun run = Run(Article(u"Garden Tips"_qs, kSiteContents)
                             + QStringList{u"--site"_qs, m_out, u"--pages"_qs, u"3"_qs});
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

    // "Manual": the last meaning's synonyms; a word without entry is known without alternatives.
    const QString folder = m_home + u"/data/"_qs;
    QCOMPARE(Files(folder), (QStringList{u"bloom.dat"_qs, u"flowers.dat"_qs, u"garden.dat"_qs, u"plant.dat"_qs,
                                         u"quickly.dat"_qs, u"tips.dat"_qs}));
    QCOMPARE(ReadBytes(folder + u"garden.dat"_qs), QByteArray("cultivate, grow"));
    QCOMPARE(ReadBytes(folder + u"bloom.dat"_qs), QByteArray("blossom, flower"));
    QCOMPARE(ReadBytes(folder + u"quickly.dat"_qs), QByteArray("rapidly, speedily, fast"));
    QCOMPARE(ReadBytes(folder + u"tips.dat"_qs), QByteArray());
    QCOMPARE(ReadBytes(folder + u"flowers.dat"_qs), QByteArray());
    QCOMPARE(ReadBytes(folder + u"plant.dat"_qs), QByteArray("sow, seed")); // from its file, not looked up

    // The next run finds every word.
    run = Run(arguments + QStringList{u"--list-new"_qs});
    QCOMPARE(run.ExitCode, 0);
    QCOMPARE(run.Out, QByteArray());
    // The alternatives written are the ones the versions draw from.
    const QString output = m_out + u"/garden.txt"_qs;
    run = Run(Article(u"Garden"_qs, u"Garden garden garden garden garden garden."_qs)
              + QStringList{u"--level"_qs, u"Maximum"_qs, u"--text"_qs, output});
    QCOMPARE(run.ExitCode, 0);
    const QString version = ReadTextFile(output);
    const bool replaced = version.contains(u"cultivate"_qs, Qt::CaseInsensitive)
        || version.contains(u"grow"_qs, Qt::CaseInsensitive);
    QVERIFY2(replaced, qPrintable(version));
}

void TestBatch::lookupUsesEmbeddedThesaurus()
{
    if (!QFile::exists(ThesaurusService::DefaultDataPath() + u".idx"_qs))
        QSKIP("The thesaurus data of the package mythes-en-us is not installed");
    // No SETTINGS.INI: the thesaurus built into the program answers.
    const BatchRun run = Run(Article(u"Happy"_qs, u"Happy gardeners."_qs) + QStringList{u"--lookup"_qs,
                                                                                         u"--list-new"_qs});
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
    const BatchRun run = Run(Article(u"Garden Tips"_qs, u"Plant flowers."_qs)
                             + QStringList{u"--lookup"_qs, u"--text"_qs, output});
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
    for (const QString &option :
         {u"--home"_qs, u"--title"_qs, u"--contents "_qs, u"--contents-text"_qs, u"--level"_qs, u"--ignore-shorter"_qs,
          u"--ignore "_qs, u"--lookup"_qs, u"--seed"_qs, u"--text"_qs, u"--sql"_qs, u"--table"_qs, u"--title-field"_qs,
          u"--article-field"_qs, u"--count"_qs, u"--rss"_qs, u"--url"_qs, u"--description-chars"_qs, u"--site"_qs,
          u"--pages"_qs, u"--links"_qs, u"--template"_qs, u"--extension"_qs, u"--force"_qs, u"--list-new"_qs,
          u"SOURCE_DATE_EPOCH"_qs, u"Exit status"_qs})
        QVERIFY2(help.contains(option), qPrintable(option));
}

QTEST_GUILESS_MAIN(TestBatch)
#include "tst_batch.moc"
