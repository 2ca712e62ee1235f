#pragma once

#include "engine/SpinGenerator.h"
#include "export/VersionSource.h"

namespace verbloom {

/// The versions of the spin generator: what the windows and the batch tool hand to the exports.
class SpinnerVersionSource final : public VersionSource
{
public:
    explicit SpinnerVersionSource(Spinner &spinner)
        : m_spinner(spinner)
    {
    }
    QString NextTitle() override { return m_spinner.SpinTitle(); }
    QString NextContents() override { return m_spinner.SpinContents(); }

private:
    Spinner &m_spinner;
};

} // namespace verbloom
