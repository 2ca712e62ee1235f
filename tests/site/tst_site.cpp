#include "export/TestVersions.h"

#include "common/TextFile.h"
#include "site/SiteConfig.h"
#include "site/TemplateFiles.h"
#include "site/modGenerateWebPages.h"

#include <QDir>
#include <QFile>
#include <QRegularExpression>
#include <QTemporaryDir>
#include <QtTest>

#include <memory>

using namespace verbloom;

namespace {

const QString kData = QStringLiteral(VERBLOOM_TEST_DATA);

QString PageTitle(int k)
{
    return QStringLiteral("Tip %1").arg(k);
}

// CR LF, a lone LF and a lone CR: the first two become "<br>", the CR stays.
QString PageContents(int k)
{
    return QStringLiteral("Line %1\r\nsecond\nthird\rfourth ").arg(k);
}

SiteOptions GoldenOptions(const QString &outputFolder)
{
    SiteOptions options = DefaultSiteOptions({u"plain.htm"_qs});
    options.OutputFolder = outputFolder;
    options.TopCode = u"<b>Top ad</b>"_qs;
    options.LeftCode = u"<i>Left</i>"_qs;
    options.RightCode = u"Right & more"_qs;
    options.BottomCode = u"(c) 2026\r\nAll rights reserved"_qs;
    return options;
}

QStringList Files(const QString &folder)
{
    return QDir(folder).entryList(QDir::Files, QDir::Name);
}

// The page numbers a content page's menu links to, in order.
QList<int> MenuTargets(const QString &page)
{
    QList<int> targets;
    static const QRegularExpression link(u"&rsaquo;&rsaquo;<a href ='page(\\d+)\\.htm'>"_qs);
    for (const QRegularExpressionMatch &match : link.globalMatch(page))
        targets.append(match.captured(1).toInt());
    return targets;
}

QList<int> Range(int first, int last)
{
    QList<int> numbers;
    for (int n = first; n <= last; ++n)
        numbers.append(n);
    return numbers;
}

} // namespace

class TestSite final : public QObject
{
    Q_OBJECT

private slots:
    void init();

    void listsTemplatesAndDefaults();
    void savesDefaultsByteForByte();
    void readsRecordsByPosition();
    void roundTripsEveryOption();
    void refusesDollarSeparator_data();
    void refusesDollarSeparator();
    void missingConfigKeepsDefaults();
    void validatesOptions_data();
    void validatesOptions();
    void saveContentsMessages();

    void cleansFileNames_data();
    void cleansFileNames();
    void refusesCaptionThatGrowsTooLong();
    void countsLinksLikeVal_data();
    void countsLinksLikeVal();

    void generatesSites_data();
    void generatesSites();
    void menusWrapRound();
    void refusesPageCountOutsideRange_data();
    void refusesPageCountOutsideRange();
    void countsFilesThatFail();
    void createsMissingTemplateEmpty();
    void skipsEmptyVersions();
    void checksBeforeGeneration();

    void templateEditorFiles();

private:
    std::unique_ptr<QTemporaryDir> m_dir;
    QString m_home;
    QString m_out;
};

void TestSite::init()
{
    m_dir = std::make_unique<QTemporaryDir>();
    QVERIFY(m_dir->isValid());
    m_home = m_dir->filePath(u"home"_qs);
    m_out = m_dir->filePath(u"out"_qs);
    QVERIFY(QDir().mkpath(m_home + u"/templates"_qs));
    QVERIFY(QDir().mkpath(m_out));
    QVERIFY(QFile::copy(kData + u"/templates/plain.htm"_qs, m_home + u"/templates/plain.htm"_qs));
}

void TestSite::listsTemplatesAndDefaults()
{
    QVERIFY(WriteTextFile(m_home + u"/templates/b.htm"_qs, u"b"_qs));
    QVERIFY(WriteTextFile(m_home + u"/templates/A.txt"_qs, u"a"_qs));
    QVERIFY(QDir().mkpath(m_home + u"/templates/folder"_qs));
    const SiteSettings settings = LoadSettings(m_home);
    QCOMPARE(settings.Templates, (QStringList{u"A.txt"_qs, u"b.htm"_qs, u"plain.htm"_qs}));
    SiteOptions expected;
    expected.Template = u"A.txt"_qs;
    QCOMPARE(settings.Options, expected);
    QCOMPARE(expected.FileExtension, u"htm"_qs);
    QCOMPARE(expected.ReplaceChar, u"_"_qs);
    QCOMPARE(expected.LinkCount, u"10"_qs);
    QCOMPARE(expected.NoOfPages, u"25"_qs);
    QCOMPARE(expected.NavigationLinkName, u"Link"_qs);
    QVERIFY(expected.CreateIndex && expected.FileNamesSmallCase && expected.CreateSiteMap);

    // Without a templates folder the list is empty and no template is selected.
    QVERIFY(QDir(m_home + u"/templates"_qs).removeRecursively());
    QVERIFY(ListTemplates(m_home).isEmpty());
    QCOMPARE(LoadSettings(m_home).Options.Template, QString());
}

void TestSite::savesDefaultsByteForByte()
{
    SiteOptions options = DefaultSiteOptions({u"A.htm"_qs, u"plain.htm"_qs});
    options.OutputFolder = u"/srv/site"_qs;
    QVERIFY(!SaveConfig(m_home, options));
    QCOMPARE(ReadBytes(m_home + u"/config.txt"_qs), ReadBytes(kData + u"/config_defaults.txt"_qs));
    QCOMPARE(ConfigKeys().size(), 14);
}

void TestSite::readsRecordsByPosition()
{
    QVERIFY(WriteTextFile(m_home + u"/templates/other.htm"_qs, QString()));
    QVERIFY(QFile::copy(kData + u"/config_positions.txt"_qs, m_home + u"/config.txt"_qs));
    const SiteOptions options = LoadSettings(m_home).Options;
    QCOMPARE(options.OutputFolder, u"/old/folder"_qs);
    QCOMPARE(options.Template, u"other.htm"_qs); // "gone.htm" is not listed: the first stays
    QCOMPARE(options.FileExtension, u"php"_qs);  // position 2, whatever its key
    QCOMPARE(options.ReplaceChar, u"_"_qs);      // no "?": skipped
    QCOMPARE(options.CreateIndex, true);         // "2" is no check state: skipped
    QCOMPARE(options.FileNamesSmallCase, false);
    QCOMPARE(options.CreateSiteMap, true);
    QCOMPARE(options.LinkCount, u"7"_qs);
    QCOMPARE(options.NoOfPages, u"12"_qs);
    QCOMPARE(options.TopCode, u"<a href='ad.php?id=1&x=?'>top</a>\r\nline two"_qs);
    QCOMPARE(options.LeftCode, u"left"_qs);
    QCOMPARE(options.BottomCode, u"bottom"_qs);
    QCOMPARE(options.RightCode, u"right"_qs);
    QCOMPARE(options.NavigationLinkName, u"Page?"_qs);
}

void TestSite::roundTripsEveryOption()
{
    QVERIFY(WriteTextFile(m_home + u"/templates/z.htm"_qs, QString()));
    SiteOptions options;
    options.OutputFolder = u" /a folder/with?mark "_qs;
    options.Template = u"z.htm"_qs;
    options.FileExtension = u"HTML"_qs;
    options.ReplaceChar = QString();
    options.CreateIndex = false;
    options.FileNamesSmallCase = false;
    options.CreateSiteMap = false;
    options.LinkCount = u" 5 "_qs;
    options.NoOfPages = u"2.5"_qs;
    options.TopCode = u"<script>\r\nvar q = 'a?b';\r\n</script>"_qs;
    options.LeftCode = u"$$ a $ b"_qs;
    options.BottomCode = u"\u00a9 Gr\u00fc\u00dfe"_qs;
    options.RightCode = u"?"_qs;
    options.NavigationLinkName = u"Next page"_qs;
    QVERIFY(!SaveConfig(m_home, options));
    QCOMPARE(LoadSettings(m_home).Options, options);
}

void TestSite::refusesDollarSeparator_data()
{
    QTest::addColumn<int>("field");
    QTest::addColumn<QString>("added");
    QTest::addColumn<QString>("label");
    QTest::newRow("top") << 0 << u"Price: $$$ only"_qs << u"Ad code for top of the page"_qs;
    QTest::newRow("bottom") << 1 << u"$$$"_qs << u"Copyright and other content for the bottom of the page"_qs;
    QTest::newRow("link name ends with $") << 2 << u"5$"_qs << u"Navigation Link Name:"_qs;
    QTest::newRow("extension ends with $$") << 3 << u"$$"_qs << u"File Extension:"_qs;
}

void TestSite::refusesDollarSeparator()
{
    QFETCH(int, field);
    QFETCH(QString, added);
    QFETCH(QString, label);
    QVERIFY(WriteTextFile(m_home + u"/config.txt"_qs, u"old"_qs));
    SiteOptions options = GoldenOptions(m_out);
    QString *values[] = {&options.TopCode, &options.BottomCode, &options.NavigationLinkName,
                         &options.FileExtension};
    *values[field] += added;
    const std::optional<UserMessage> refusal = SaveConfig(m_home, options);
    QVERIFY(refusal);
    QCOMPARE(refusal->Text, u"The option \""_qs + label
                                + u"\" contains \"$$$\" or ends with \"$\", which config.txt cannot store. "
                                  "Please change it; nothing was saved."_qs);
    QCOMPARE(ReadTextFile(m_home + u"/config.txt"_qs), u"old"_qs);
    QCOMPARE(SaveContents(m_home, options).Text, refusal->Text);
}

void TestSite::missingConfigKeepsDefaults()
{
    SiteOptions options = DefaultSiteOptions({u"plain.htm"_qs});
    const SiteOptions defaults = options;
    ReadConfig(m_home, {u"plain.htm"_qs}, options);
    QCOMPARE(options, defaults);
    ReadConfig(m_home + u"/missing"_qs, {u"plain.htm"_qs}, options);
    QCOMPARE(options, defaults);
}

void TestSite::validatesOptions_data()
{
    QTest::addColumn<QString>("outputFolder"); // "OUT" stands for the existing folder
    QTest::addColumn<QString>("extension");
    QTest::addColumn<QString>("links");
    QTest::addColumn<QString>("pages");
    QTest::addColumn<QString>("decimalPoint");
    QTest::addColumn<QString>("message");
    const QString dot = u"."_qs;
    QTest::newRow("no folder") << u""_qs << u""_qs << u""_qs << u""_qs << dot << u"Please browse output folder"_qs;
    QTest::newRow("folder gone") << u"OUT/gone"_qs << u""_qs << u""_qs << u""_qs << dot
                                 << u"Output folder does't exist"_qs;
    QTest::newRow("extension") << u"OUT"_qs << u""_qs << u""_qs << u""_qs << dot
                               << u"Please enter the file extension"_qs;
    QTest::newRow("links empty") << u"OUT"_qs << u"htm"_qs << u""_qs << u""_qs << dot
                                 << u"Please specify number of links in menu per page"_qs;
    QTest::newRow("links word") << u"OUT"_qs << u"htm"_qs << u"ten"_qs << u""_qs << dot
                                << u"Number of links in menu per page should be numeric"_qs;
    QTest::newRow("links blanks") << u"OUT"_qs << u"htm"_qs << u"   "_qs << u""_qs << dot
                                  << u"Number of links in menu per page should be numeric"_qs;
    QTest::newRow("pages empty") << u"OUT"_qs << u"htm"_qs << u" 10 "_qs << u""_qs << dot
                                 << u"Please specify number of pages to generate"_qs;
    QTest::newRow("pages word") << u"OUT"_qs << u"htm"_qs << u"10"_qs << u"x25"_qs << dot
                                << u"Number of pages to generate should be numeric"_qs;
    QTest::newRow("pages too many") << u"OUT"_qs << u"htm"_qs << u"10"_qs << u"32768"_qs << dot
                                    << u"Number of pages to generate should be between 0 and 32767"_qs;
    QTest::newRow("pages below 16 bits") << u"OUT"_qs << u"htm"_qs << u"10"_qs << u"-32769"_qs << dot
                                         << u"Number of pages to generate should be between 0 and 32767"_qs;
    QTest::newRow("pages negative: none") << u"OUT"_qs << u"htm"_qs << u"10"_qs << u"-32768"_qs << dot
                                          << QString();
    QTest::newRow("valid") << u"OUT"_qs << u" "_qs << u" 10 "_qs << u"1e1"_qs << dot << QString();
    QTest::newRow("comma locale") << u"OUT"_qs << u"htm"_qs << u"2,5"_qs << u"0"_qs << u","_qs << QString();
    QTest::newRow("dot under comma locale") << u"OUT"_qs << u"htm"_qs << u"2.5"_qs << u"0"_qs << u","_qs
                                            << u"Number of links in menu per page should be numeric"_qs;
}

void TestSite::validatesOptions()
{
    QFETCH(QString, outputFolder);
    QFETCH(QString, extension);
    QFETCH(QString, links);
    QFETCH(QString, pages);
    QFETCH(QString, decimalPoint);
    QFETCH(QString, message);
    SiteOptions options;
    options.OutputFolder = outputFolder.replace(u"OUT"_qs, m_out);
    options.FileExtension = extension;
    options.LinkCount = links;
    options.NoOfPages = pages;
    const std::optional<UserMessage> failure = ValidateOptions(options, decimalPoint.at(0));
    QCOMPARE(failure ? failure->Text : QString(), message);
    if (failure) {
        QCOMPARE(failure->Title, u"Message"_qs);
        QCOMPARE(failure->IconKind, UserMessage::Icon::Information);
        QCOMPARE(failure->ButtonSet, UserMessage::Buttons::Ok);
    }
}

void TestSite::saveContentsMessages()
{
    const SiteOptions options = GoldenOptions(m_out);
    QCOMPARE(SaveContents(m_home, options), InformationMessage(u"Config setting has been saved"_qs));
    QCOMPARE(ReadTextFile(m_home + u"/config.txt"_qs), ConfigText(options));
    SiteOptions invalid = options;
    invalid.OutputFolder.clear();
    QCOMPARE(SaveContents(m_home, invalid).Text, u"Please browse output folder"_qs);
    const UserMessage failed = SaveContents(m_home + u"/missing"_qs, options);
    QCOMPARE(failed.Text, u"Config setting could not be saved as "_qs + m_home + u"/missing/config.txt"_qs);
    QCOMPARE(failed.IconKind, UserMessage::Icon::Exclamation);
}

void TestSite::cleansFileNames_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<QString>("replacement");
    QTest::addColumn<QString>("expected");
    QTest::newRow("blank") << u"My Link"_qs << u"_"_qs << u"My_Link"_qs;
    QTest::newRow("later steps see earlier ones") << u"a b"_qs << u"-="_qs << u"a--=-=b"_qs;
    QTest::newRow("every listed character") << u" ',&~!@#$%^*)-=+{}[]:<>.?/\\"_qs << u""_qs << u""_qs;
    QTest::newRow("kept characters") << u"(\"|;_aZ9\u00e9"_qs << u""_qs << u"(\"|;_aZ9\u00e9"_qs;
    QTest::newRow("brace twice") << u"{"_qs << u"x{"_qs << u"xx{"_qs;
    QTest::newRow("one pass per step") << u"--"_qs << u"--"_qs << u"----"_qs;
    QTest::newRow("empty replacement") << u"a b.c"_qs << QString() << u"abc"_qs;
}

void TestSite::cleansFileNames()
{
    QFETCH(QString, text);
    QFETCH(QString, replacement);
    QFETCH(QString, expected);
    bool tooLong = true;
    QCOMPARE(CleanFileName(text, replacement, &tooLong), expected);
    QVERIFY(!tooLong);
}

void TestSite::refusesCaptionThatGrowsTooLong()
{
    // Each step would multiply the text: the cleaning stops instead of eating all memory.
    const QString replacement = u"',&~!@#$%^*)-=+{}[]:<>.?/\\"_qs;
    bool tooLong = false;
    const QString cleaned = CleanFileName(u"a b"_qs, replacement, &tooLong);
    QVERIFY(tooLong);
    QVERIFY(cleaned.size() <= 65536);

    SiteOptions options = GoldenOptions(m_out);
    options.NavigationLinkName = u"My Link"_qs;
    options.ReplaceChar = replacement;
    ArticleBoxes boxes{u"T "_qs, u"C "_qs};
    NumberedVersions versions(&PageTitle, &PageContents);
    const SiteRunResult result = GenerateWebSite(m_home, options, boxes, versions);
    QVERIFY(result.Refused);
    QCOMPARE(result.Messages.size(), 1);
    QVERIFY(result.Messages[0].Text.startsWith(u"The navigation link name grows too long"_qs));
    QVERIFY(Files(m_out).isEmpty());
    QCOMPARE(versions.TitlesMade(), 0);
}

void TestSite::countsLinksLikeVal_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<int>("links");
    QTest::newRow("leading number") << u" 7 links"_qs << 7;
    QTest::newRow("3.5 rounds to even") << u"3.5"_qs << 4;
    QTest::newRow("comma stops") << u"2,5"_qs << 2;
    QTest::newRow("beyond 16 bits: no links") << u"40000"_qs << 0;
}

void TestSite::countsLinksLikeVal()
{
    QFETCH(QString, text);
    QFETCH(int, links);
    QCOMPARE(LinksPerPage(text), links);
}

void TestSite::generatesSites_data()
{
    QTest::addColumn<QString>("golden");
    QTest::addColumn<QString>("pages");
    QTest::addColumn<QString>("links");
    QTest::addColumn<QString>("caption");
    QTest::addColumn<bool>("lowercase");
    QTest::addColumn<bool>("index");
    QTest::addColumn<bool>("sitemap");
    QTest::addColumn<QString>("extension");
    QTest::addColumn<QString>("initialTitle");
    QTest::addColumn<QString>("opened");

    QTest::newRow("25 pages x 10 links") << u"site_25x10"_qs << u"25"_qs << u"10"_qs << u"Link"_qs << true << true
                                         << true << u"htm"_qs << u"Garden Tips "_qs << u"index.htm"_qs;
    QTest::newRow("3 pages x 10 links, cleaned caption")
        << u"site_3x10"_qs << u"3"_qs << u"10"_qs << u"My Link"_qs << false << true << false << u"HTML"_qs
        << u"Garden #CONTENT# Tips "_qs << u"index.HTML"_qs;
    QTest::newRow("0 pages") << u"site_0pages"_qs << u"0"_qs << u"10"_qs << u"Link"_qs << true << true << true
                             << u"htm"_qs << u"Garden Tips "_qs << u"index.htm"_qs;
    QTest::newRow("-2 pages as 0") << u"site_0pages"_qs << u"-2"_qs << u"10"_qs << u"Link"_qs << true << true
                                   << true << u"htm"_qs << u"Garden Tips "_qs << u"index.htm"_qs;
    QTest::newRow("lowercase caption, no index") << u"site_caption_lower"_qs << u"2"_qs << u"3"_qs
                                                 << u"My Link"_qs << true << false << true << u"htm"_qs
                                                 << u"Garden Tips "_qs << u"page1.htm"_qs;
}

void TestSite::generatesSites()
{
    QFETCH(QString, golden);
    QFETCH(QString, pages);
    QFETCH(QString, links);
    QFETCH(QString, caption);
    QFETCH(bool, lowercase);
    QFETCH(bool, index);
    QFETCH(bool, sitemap);
    QFETCH(QString, extension);
    QFETCH(QString, initialTitle);
    QFETCH(QString, opened);

    SiteOptions options = GoldenOptions(m_out);
    options.NoOfPages = pages;
    options.LinkCount = links;
    options.NavigationLinkName = caption;
    options.FileNamesSmallCase = lowercase;
    options.CreateIndex = index;
    options.CreateSiteMap = sitemap;
    options.FileExtension = extension;
    ArticleBoxes boxes{initialTitle, u"Plant early.\r\nWater often. "_qs};
    NumberedVersions versions(&PageTitle, &PageContents);

    const SiteRunResult result = GenerateWebSite(m_home, options, boxes, versions);
    QVERIFY(!result.Refused);
    QVERIFY(result.Messages.isEmpty());
    QVERIFY(result.FailedFiles.isEmpty());

    const QString expectedFolder = kData + u"/"_qs + golden;
    const QStringList expectedFiles = Files(expectedFolder);
    QCOMPARE(Files(m_out), expectedFiles);
    QCOMPARE(result.FilesWritten, expectedFiles.size());
    for (const QString &file : expectedFiles)
        QVERIFY2(ReadBytes(m_out + u"/"_qs + file) == ReadBytes(expectedFolder + u"/"_qs + file), qPrintable(file));

    const int count = qMax(0, pages.toInt());
    QCOMPARE(result.PageNames.size(), count);
    if (count > 0) {
        QCOMPARE(result.PageNames.first(), u"page1"_qs);
        QCOMPARE(result.PageNames.last(), u"page"_qs + pages);
    }
    QCOMPARE(result.OpenPath, m_out + u"/"_qs + opened);
    // The boxes hold one more version, which no page carries.
    QCOMPARE(boxes.Title, count == 0 ? initialTitle : PageTitle(count + 1));
    QCOMPARE(versions.TitlesMade(), count);
    if (index && count > 0) {
        QCOMPARE(ReadBytes(m_out + u"/index."_qs + extension),
                 ReadBytes(m_out + u"/page"_qs + pages + u"."_qs + extension));
    }
}

void TestSite::menusWrapRound()
{
    SiteOptions options = GoldenOptions(m_out);
    ArticleBoxes boxes{u"Garden Tips "_qs, u"Plant early. "_qs};
    NumberedVersions versions(&PageTitle, &PageContents);
    const SiteRunResult result = GenerateWebSite(m_home, options, boxes, versions);
    QCOMPARE(result.FilesWritten, 27);
    QCOMPARE(MenuTargets(ReadTextFile(m_out + u"/page1.htm"_qs)), Range(1, 10));
    QCOMPARE(MenuTargets(ReadTextFile(m_out + u"/page2.htm"_qs)), Range(11, 20));
    QCOMPARE(MenuTargets(ReadTextFile(m_out + u"/page3.htm"_qs)), Range(21, 25) + Range(1, 5));
    QCOMPARE(MenuTargets(ReadTextFile(m_out + u"/page4.htm"_qs)), Range(6, 15));
    QCOMPARE(result.MenuPosition, 0); // 25 menus of 10 links end where they began
    QVERIFY(ReadTextFile(m_out + u"/page1.htm"_qs).contains(u"<title>Garden Tips </title>"_qs));
    QVERIFY(!ReadTextFile(m_out + u"/sitemap.htm"_qs).contains(u"&rsaquo;"_qs));

    QStringList three{u"page1"_qs, u"page2"_qs, u"page3"_qs};
    qsizetype position = 0;
    const QString menu = BuildNavigationMenu(three, position, u"L"_qs, u"htm"_qs, 10, u"_"_qs);
    QCOMPARE(MenuTargets(menu), (QList<int>{1, 2, 3, 1, 2, 3, 1, 2, 3, 1}));
    QCOMPARE(position, 1);
    QVERIFY(BuildNavigationMenu({}, position, u"L"_qs, u"htm"_qs, 10, u"_"_qs).isEmpty());
}

void TestSite::refusesPageCountOutsideRange_data()
{
    QTest::addColumn<QString>("pages");
    QTest::newRow("32768") << u"32768"_qs;
    QTest::newRow("-32768.6") << u"-32768.6"_qs;
    QTest::newRow("word") << u"many"_qs;
}

void TestSite::refusesPageCountOutsideRange()
{
    QFETCH(QString, pages);
    SiteOptions options = GoldenOptions(m_out);
    options.NoOfPages = pages;
    ArticleBoxes boxes{u"T "_qs, u"C "_qs};
    NumberedVersions versions(&PageTitle, &PageContents);
    const SiteRunResult result = GenerateWebSite(m_home, options, boxes, versions);
    QVERIFY(result.Refused);
    QCOMPARE(result.Messages.size(), 1);
    QCOMPARE(result.Messages[0].Text, u"Number of pages to generate should be between 0 and 32767"_qs);
    QVERIFY(Files(m_out).isEmpty());
    QCOMPARE(boxes.Title, u"T "_qs);
    QVERIFY(result.OpenPath.isEmpty());
}

void TestSite::countsFilesThatFail()
{
    QVERIFY(QDir().mkpath(m_out + u"/page2.htm"_qs)); // a folder where a page should go
    SiteOptions options = GoldenOptions(m_out);
    ArticleBoxes boxes{u"Garden Tips "_qs, u"Plant early. "_qs};
    NumberedVersions versions(&PageTitle, &PageContents);
    const SiteRunResult result = GenerateWebSite(m_home, options, boxes, versions);
    QCOMPARE(result.FilesWritten, 26);
    QCOMPARE(result.FailedFiles, QStringList{m_out + u"/page2.htm"_qs});
    QCOMPARE(result.Messages.size(), 1);
    QCOMPARE(result.Messages[0].Text, u"1 of 27 files could not be written:\r\n"_qs + m_out + u"/page2.htm"_qs);
    QCOMPARE(result.Messages[0].IconKind, UserMessage::Icon::Exclamation);
    QCOMPARE(result.OpenPath, m_out + u"/index.htm"_qs);
    QVERIFY(QFileInfo::exists(m_out + u"/page25.htm"_qs));
}

void TestSite::createsMissingTemplateEmpty()
{
    SiteOptions options = GoldenOptions(m_out);
    options.Template = u"new one.htm"_qs;
    options.NoOfPages = u"2"_qs;
    ArticleBoxes boxes{u"T "_qs, u"C "_qs};
    NumberedVersions versions(&PageTitle, &PageContents);
    const SiteRunResult result = GenerateWebSite(m_home, options, boxes, versions);
    QCOMPARE(result.FilesWritten, 4);
    QVERIFY(QFileInfo(m_home + u"/templates/new one.htm"_qs).isFile());
    QCOMPARE(QFileInfo(m_home + u"/templates/new one.htm"_qs).size(), 0);
    for (const QString &file : Files(m_out))
        QCOMPARE(QFileInfo(m_out + u"/"_qs + file).size(), 0);

    // A name that leaves the templates folder is no template and creates nothing.
    QVERIFY(TemplateReadPath(m_home, u"../config.txt"_qs).isEmpty());
    QVERIFY(ReadTemplate(m_home, u"../x.htm"_qs).isEmpty());
    QVERIFY(!QFileInfo::exists(m_home + u"/x.htm"_qs));
}

void TestSite::skipsEmptyVersions()
{
    // Version 3 has an empty title: no page3, and no menu or site map entry points at it.
    SiteOptions options = GoldenOptions(m_out);
    options.NoOfPages = u"4"_qs;
    options.LinkCount = u"3"_qs;
    options.FileNamesSmallCase = false;
    ArticleBoxes boxes{u"T "_qs, u"C "_qs};
    NumberedVersions versions([](int k) { return k == 3 ? QString() : PageTitle(k); }, &PageContents);
    const SiteRunResult result = GenerateWebSite(m_home, options, boxes, versions);
    QCOMPARE(result.PageNames, (QStringList{u"page1"_qs, u"page2"_qs, u"page4"_qs}));
    QCOMPARE(Files(m_out), (QStringList{u"index.htm"_qs, u"page1.htm"_qs, u"page2.htm"_qs, u"page4.htm"_qs,
                                        u"sitemap.htm"_qs}));
    QVERIFY(ReadTextFile(m_out + u"/sitemap.htm"_qs).contains(u"<li><a href ='page4.htm'>Link3</a><br>"_qs));
    QCOMPARE(MenuTargets(ReadTextFile(m_out + u"/page2.htm"_qs)), (QList<int>{1, 2, 4}));
    QCOMPARE(ReadBytes(m_out + u"/index.htm"_qs), ReadBytes(m_out + u"/page4.htm"_qs));
}

void TestSite::checksBeforeGeneration()
{
    SiteOptions options = GoldenOptions(m_out);
    SiteGenerationCheck check = CheckSiteGeneration(options);
    QVERIFY(check.Valid);
    QVERIFY(check.Messages.isEmpty());

    const UserMessage question{u"File already exist!!!! Do you wand to continue"_qs, u"Verbloom"_qs,
                               UserMessage::Icon::Critical, UserMessage::Buttons::YesNo};
    QVERIFY(WriteTextFile(m_out + u"/index.htm"_qs, u"old"_qs));
    check = CheckSiteGeneration(options);
    QVERIFY(check.Valid);
    QCOMPARE(check.Messages, QList<UserMessage>{question});

    // The question follows a failed check all the same.
    options.LinkCount = u"ten"_qs;
    check = CheckSiteGeneration(options);
    QVERIFY(!check.Valid);
    QCOMPARE(check.Messages.size(), 2);
    QCOMPARE(check.Messages[0].Text, u"Number of links in menu per page should be numeric"_qs);
    QCOMPARE(check.Messages[1], question);

    options.LinkCount = u"10"_qs;
    options.RightCode = u"$$$"_qs;
    check = CheckSiteGeneration(options);
    QVERIFY(!check.Valid);
    QVERIFY(check.Messages[0].Text.startsWith(u"The option \"Ad code for the right of the page\""_qs));

    const UserMessage start = WebPagesQuestion(options);
    QCOMPARE(start.Text, u"Web pages will be generated in \r\n"_qs + m_out);
    QCOMPARE(start.Title, u"Message"_qs);
    QCOMPARE(start.ButtonSet, UserMessage::Buttons::OkCancel);
}

void TestSite::templateEditorFiles()
{
    const QString path = TemplateFilePath(m_home, u"  fresh.htm  "_qs);
    QCOMPARE(path, m_home + u"/templates/fresh.htm"_qs);
    QCOMPARE(ReadOrCreateTemplate(path), QString());
    QVERIFY(QFileInfo(path).isFile());

    QCOMPARE(SaveTemplate(path, u"<p>#TITLE#</p>\r\n"_qs), InformationMessage(u"Template has been Saved"_qs));
    QCOMPARE(ReadOrCreateTemplate(path), u"<p>#TITLE#</p>\r\n"_qs);
    const QString missing = m_home + u"/no-such-folder/t.htm"_qs;
    const UserMessage failed = SaveTemplate(missing, u"x"_qs);
    QCOMPARE(failed.Text, u"Template could not be saved as "_qs + missing);
    QCOMPARE(failed.IconKind, UserMessage::Icon::Exclamation);
    QVERIFY(ReadOrCreateTemplate(missing).isEmpty());
    QVERIFY(!QFileInfo::exists(missing));

    // The preview copy leaves the template as it was.
    QCOMPARE(WritePreviewFile(m_home, u"<title>Draft</title>#TITLE#"_qs), m_home + u"/temp.htm"_qs);
    QCOMPARE(ReadTextFile(m_home + u"/temp.htm"_qs), u"<title>Draft</title>#TITLE#"_qs);
    QCOMPARE(ReadTextFile(path), u"<p>#TITLE#</p>\r\n"_qs);
}

QTEST_GUILESS_MAIN(TestSite)
#include "tst_site.moc"
