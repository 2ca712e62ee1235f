#include "export/VersionSource.h"

#include <utility>

namespace verbloom {

FunctionVersionSource::FunctionVersionSource(std::function<QString()> nextTitle,
                                             std::function<QString()> nextContents)
    : m_nextTitle(std::move(nextTitle))
    , m_nextContents(std::move(nextContents))
{
}

QString FunctionVersionSource::NextTitle()
{
    return m_nextTitle ? m_nextTitle() : QString();
}

QString FunctionVersionSource::NextContents()
{
    return m_nextContents ? m_nextContents() : QString();
}

void AdvanceBoxes(ArticleBoxes &boxes, VersionSource &source)
{
    boxes.Title = source.NextTitle();
    boxes.Contents = source.NextContents();
}

} // namespace verbloom
