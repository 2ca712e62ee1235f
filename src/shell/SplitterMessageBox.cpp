#include "SplitterMessageBox.h"

#include "UiServices.h"

#include <QApplication>

namespace verbloom {

SplitterMessageBox::SplitterMessageBox(UiServices &ui)
    : m_ui(ui)
{
}

SplitterAnswer SplitterMessageBox::ShowSplitterMessage(const QString &prompt, bool designMode)
{
    UiServices::Message message;
    message.Text = prompt;
    message.Title = kSplitterMessageTitle.toString();
    message.IconKind = UiServices::Icon::Exclamation;
    message.ButtonSet = designMode ? UiServices::Buttons::YesNo : UiServices::Buttons::Ok;
    message.DefaultButton = designMode ? UiServices::Answer::No : UiServices::Answer::Ok;
    switch (m_ui.ShowMessage(QApplication::activeWindow(), message)) {
    case UiServices::Answer::Yes: return SplitterAnswer::Yes;
    case UiServices::Answer::No: return SplitterAnswer::No;
    default: return SplitterAnswer::Ok;
    }
}

} // namespace verbloom
