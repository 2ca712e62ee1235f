#pragma once

#include <QString>

namespace verbloom {

/// The main window's article boxes txtTitle and txtArticle. An export or site run takes its first
/// version from them as they stand and, after every version, puts the next one into them; the
/// run ends with one more version in the boxes, which nothing wrote.
struct ArticleBoxes
{
    QString Title;
    QString Contents;
};

/// Where the next customized version comes from (SpinTitle, then SpinContents).
class VersionSource
{
public:
    virtual ~VersionSource() = default;
    virtual QString NextTitle() = 0;
    virtual QString NextContents() = 0;
};

/// Puts the next version into the boxes: a new title first, then a new contents.
void AdvanceBoxes(ArticleBoxes &boxes, VersionSource &source);

} // namespace verbloom
