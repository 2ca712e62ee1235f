#pragma once

#include "EngineFakes.h"
#include "common/ProgramFolder.h"
#include "common/TextFile.h"
#include "engine/SuggestionsHost.h"
#include "engine/frmConfirmOptions.h"
#include "engine/frmSuggestions.h"
#include "shell/ArticleModel.h"
#include "shell/ImageCommand.h"
#include "shell/UiServices.h"

#include <QApplication>
#include <QLabel>
#include <QMouseEvent>
#include <QPlainTextEdit>
#include <QTabWidget>
#include <QTableView>
#include <QTemporaryDir>
#include <QTest>
#include <QTimer>

#include <functional>
#include <memory>

namespace verbloom::test {

inline const QString kThesaurus = QStringLiteral("http://thesaurus.test");

/// The main window as the suggestions window sees it; logs every call in order.
class FakeSuggestionsHost final : public SuggestionsHost
{
public:
    WordTestSettings Settings;      ///< "3 Letters": words of four letters or more are customizable
    FakePageSource Page;
    QString Host = kThesaurus;
    bool Running = false;
    QStringList Calls;

    WordTestSettings CurrentWordTestSettings() const override { return Settings; }
    SpinSettings CurrentSpinSettings() const override { return {Settings, 0}; }
    PageSource &LookupPage() override { return Page; }
    QString ThesaurusHost() const override { return Host; }
    void ShowWaitWindow() override { Calls.append(QStringLiteral("ShowWaitWindow")); }
    void HideMainWindow() override { Calls.append(QStringLiteral("HideMainWindow")); }
    void ShowVerifyPage() override { Calls.append(QStringLiteral("ShowVerifyPage")); }
    void cmdVerifyTryAgain_Click() override { Calls.append(QStringLiteral("cmdVerifyTryAgain_Click")); }
    bool AnalysisRunning() const override { return Running; }
    void cmdNext_Click() override { Calls.append(QStringLiteral("cmdNext_Click")); }
    void SetButton(bool enabled) override
    {
        Calls.append(enabled ? QStringLiteral("SetButton(true)") : QStringLiteral("SetButton(false)"));
    }
    void UnloadWaitWindow() override { Calls.append(QStringLiteral("UnloadWaitWindow")); }
    void ShowMainWindow() override { Calls.append(QStringLiteral("ShowMainWindow")); }
};

/// A thesaurus page with one meaning per (entry word, synonyms) pair, laid out as the parser expects.
inline QString MeaningsPage(const QList<std::pair<QString, QString>> &meanings)
{
    QStringList lines{QStringLiteral("Thesaurus")};
    for (const auto &[entry, synonyms] : meanings)
        lines << QStringLiteral("Main Entry: ") + entry << QStringLiteral("Part of Speech: adjective")
              << QStringLiteral("Definition: -") << QStringLiteral("Synonyms: ") + synonyms;
    lines << QStringLiteral("--") << QStringLiteral("--") << QStringLiteral("--");
    return PageLines(lines);
}

inline QString SearchUrl(const QString &word)
{
    return kThesaurus + QStringLiteral("/search?q=") + word;
}

/// One suggestions window over a fresh program folder, with a scripted main window and dialogs.
class SuggestionsRig
{
public:
    QTemporaryDir Folder;
    FakeSuggestionsHost Host;
    ScriptedUiServices Ui;
    std::unique_ptr<frmSuggestions> Window;

    /// `files`: word file name (without ".dat") -> content, written before the window loads.
    explicit SuggestionsRig(const QHash<QString, QString> &files = {})
    {
        SetProgramFolder(Folder.path());
        for (auto it = files.cbegin(); it != files.cend(); ++it) {
            QDir().mkpath(Folder.path() + QStringLiteral("/data"));
            WriteTextFile(WordFile(it.key()), it.value());
        }
        Host.Settings.MinimumWordLength = 3;
        StopProcessing = true;
        Window = std::make_unique<frmSuggestions>(Host, Ui);
    }

    QString WordFile(const QString &word) const
    {
        return Folder.path() + QStringLiteral("/data/") + word + QStringLiteral(".dat");
    }

    /// What "Next" does: clears the stop flag and fills the lists.
    bool Analyse(const QString &title, const QString &contents)
    {
        StopProcessing = false;
        Host.Running = true;
        const bool done = FillWordLists(title, contents, CurrentArticle(), *Window, Host);
        Host.Running = false;
        return done;
    }

    template<typename T>
    T *Find(const QString &name) const
    {
        return Window->findChild<T *>(name);
    }

    QTableView *List(int list) const { return Find<QTableView>(QStringLiteral("lstSuggestions") + QString::number(list)); }
    QPlainTextEdit *Suggestions() const { return Find<QPlainTextEdit>(QStringLiteral("txtSuggestions")); }
    QString LabelText(const QString &name) const { return Find<QLabel>(name)->text(); }

    /// A mouse click on a row (from 1) of a list, after showing its tab as the user would.
    bool ClickRow(int list, int row)
    {
        auto *tabs = Find<QTabWidget>(QStringLiteral("SSTab1"));
        if (tabs->currentIndex() != list)
            tabs->setCurrentIndex(list);
        QTableView *view = List(list);
        if (!QTest::qWaitFor([&] { return view->model()->rowCount() >= row; }))
            return false;
        const QModelIndex index = view->model()->index(row - 1, 0);
        view->scrollTo(index);
        QTest::mouseClick(view->viewport(), Qt::LeftButton, {}, view->visualRect(index).center());
        return true;
    }

    /// A click on a command's caption label or image.
    void Click(const QString &name) const { QTest::mouseClick(Find<QLabel>(name), Qt::LeftButton); }
};

/// A mouse move without buttons over the widget, as the window system delivers it.
inline void MoveMouseOver(QWidget *widget)
{
    const QPointF local(2, 2);
    QMouseEvent move(QEvent::MouseMove, local, widget->mapToGlobal(local), Qt::NoButton, Qt::NoButton,
                     Qt::NoModifier);
    QApplication::sendEvent(widget, &move);
}

/// The command (image and caption) that a label or image belongs to.
inline ImageCommand *CommandOf(QWidget *part)
{
    return qobject_cast<ImageCommand *>(part->parentWidget());
}

/// Runs `act` on the next confirm-meaning window once it is shown modally; counts the windows seen.
inline void WhenConfirmShown(std::function<void(frmConfirmOptions &)> act, int *seen)
{
    auto *timer = new QTimer;
    timer->setInterval(5);
    QObject::connect(timer, &QTimer::timeout, timer, [timer, act = std::move(act), seen] {
        auto *window = qobject_cast<frmConfirmOptions *>(QApplication::activeModalWidget());
        if (!window || !window->isVisible())
            return;
        timer->stop();
        timer->deleteLater();
        ++*seen;
        act(*window);
    });
    timer->start();
}

} // namespace verbloom::test
