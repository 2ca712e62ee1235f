#pragma once

#include "export/UserMessage.h"

#include <QString>

namespace verbloom {

/// TemplateFilePath as the Edit command sets it: programFolder + "/templates/" + the trimmed name.
QString TemplateFilePath(const QString &programFolder, const QString &templateName);

/// The template file the generator reads: programFolder + "/templates/" + the name as shown
/// (not trimmed). Empty when the name cannot name a file of that folder (empty, "/", NUL, "..").
QString TemplateReadPath(const QString &programFolder, const QString &templateName);

/// Reads a template whole, creating it empty first when no such file exists (and its folder
/// does). "" when it is missing, empty, unreadable or the path is empty.
QString ReadOrCreateTemplate(const QString &path);

/// ReadTemplate of the page generator: ReadOrCreateTemplate of TemplateReadPath.
QString ReadTemplate(const QString &programFolder, const QString &templateName);

/// Save of the template editor: writes the text whole to path; the message to show is
/// "Template has been Saved", or the report that it could not be written.
UserMessage SaveTemplate(const QString &path, const QString &text);

/// programFolder + "/temp.htm".
QString PreviewFilePathFor(const QString &programFolder);

/// WritePreviewFile: writes the editor text to temp.htm in the program folder and returns that
/// path (PreviewFilePath). Errors are ignored: the preview then shows what the file holds.
QString WritePreviewFile(const QString &programFolder, const QString &text);

} // namespace verbloom
