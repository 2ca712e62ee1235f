#include "export/VersionSource.h"

namespace verbloom {

void AdvanceBoxes(ArticleBoxes &boxes, VersionSource &source)
{
    boxes.Title = source.NextTitle();
    boxes.Contents = source.NextContents();
}

} // namespace verbloom
