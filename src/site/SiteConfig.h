#pragma once

#include "export/UserMessage.h"

#include <QString>
#include <QStringList>

#include <optional>

namespace verbloom {

/// The site options of the "Save Content Options" window, in the order config.txt stores them.
struct SiteOptions
{
    QString OutputFolder;                                  ///< "OF?"      txtConfigOutputFolder
    QString Template;                                      ///< "WPT?"     cmbConfigTemplates (name only)
    QString FileExtension = QStringLiteral("htm");         ///< "WPE?"     txtConfigFileExtension
    QString ReplaceChar = QStringLiteral("_");             ///< "RC?"      txtConfigReplaceChar
    bool CreateIndex = true;                               ///< "CI?"      chkConfigCreateIndex
    bool FileNamesSmallCase = true;                        ///< "FSC?"     chkConfigFileNamesSmallCase
    bool CreateSiteMap = true;                             ///< "CSM?"     chkConfigCreateSiteMap
    QString LinkCount = QStringLiteral("10");              ///< "LC?"      txtConfigLinkCount
    QString NoOfPages = QStringLiteral("25");              ///< "NP?"      txtConfigNoOfpage
    QString TopCode;                                       ///< "TOP?"     txtTopCode
    QString LeftCode;                                      ///< "LEFT?"    txtLeftCode
    QString BottomCode;                                    ///< "BoTTOM?"  txtBottomCode
    QString RightCode;                                     ///< "RIGHT?"   txtRightCode
    QString NavigationLinkName = QStringLiteral("Link");   ///< "NAVLINK?" txtNavigationLinkName

    friend bool operator==(const SiteOptions &, const SiteOptions &) = default;
};

/// The options window's state after loading: the template list and the options.
struct SiteSettings
{
    QStringList Templates; ///< cmbConfigTemplates, in list order
    SiteOptions Options;
};

/// The keys of config.txt, in record order ("OF?" .. "NAVLINK?").
const QStringList &ConfigKeys();

/// programFolder + "/config.txt".
QString ConfigFilePath(const QString &programFolder);

/// programFolder + "/templates".
QString TemplatesFolder(const QString &programFolder);

/// ListTemplates: the names of the files (not sub-folders) in the templates folder, ordered by
/// name ignoring case; empty when the folder is missing.
QStringList ListTemplates(const QString &programFolder);

/// The options without config.txt: the defaults, with the first template selected.
SiteOptions DefaultSiteOptions(const QStringList &templates);

/// The text of config.txt: 14 records of key, value and "$$$", check boxes as "0" / "1".
QString ConfigText(const SiteOptions &options);

/// The refusal of a value that holds "$$$" (it would shift every later record) or ends with "$"
/// (it would join the separator), naming the option; nothing when every value can be stored.
std::optional<UserMessage> CheckConfigValues(const SiteOptions &options);

/// SaveConfig: writes config.txt whole. Returns the message to show when it was refused
/// (CheckConfigValues) or could not be written; nothing when it was saved.
std::optional<UserMessage> SaveConfig(const QString &programFolder, const SiteOptions &options);

/// "Config setting has been saved", the confirmation of Save Contents.
UserMessage ConfigSavedMessage();

/// Applies a config.txt text to the options: records by position, the value after the first "?";
/// a template name that is not in the list keeps the current selection; a record that cannot be
/// applied (no "?", a check value other than 0 or 1) is skipped.
void ApplyConfigText(const QString &text, const QStringList &templates, SiteOptions &options);

/// ReadConfig: ApplyConfigText with programFolder's config.txt; nothing changes when it is missing.
void ReadConfig(const QString &programFolder, const QStringList &templates, SiteOptions &options);

/// LoadSettings: ListTemplates, the defaults, then ReadConfig. The window then empties the output
/// folder (it is never shown from config.txt).
SiteSettings LoadSettings(const QString &programFolder);

/// Save Contents (cmdSave) without the window: the one message to show, which is the validation
/// failure, the refusal or failure of SaveConfig, or "Config setting has been saved".
UserMessage SaveContents(const QString &programFolder, const SiteOptions &options,
                         QChar decimalPoint = QLatin1Char('.'));

/// ValidateOptions: the first failing check as an OK message titled "Message", or nothing.
/// Numbers are read with the user's decimal point. The number of pages must also fit 16 bits
/// (nearest, halves to even), so a run never starts with a count it cannot make; a count below 0
/// makes no pages, as 0 does.
std::optional<UserMessage> ValidateOptions(const SiteOptions &options,
                                           QChar decimalPoint = QLatin1Char('.'));

} // namespace verbloom
