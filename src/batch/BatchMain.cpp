// verbloom-batch: the work of the wizard from the command line, without windows.
#include "batch/BatchArguments.h"
#include "batch/BatchConsole.h"
#include "batch/BatchRun.h"

#include <QCoreApplication>

using namespace verbloom;

int main(int argc, char *argv[])
{
    QCoreApplication app(argc, argv);
    QCoreApplication::setApplicationName(u"verbloom-batch"_qs);

    const char *epochVariable = "SOURCE_DATE_EPOCH";
    const std::optional<QString> sourceDateEpoch = qEnvironmentVariableIsSet(epochVariable)
        ? std::optional<QString>(qEnvironmentVariable(epochVariable))
        : std::nullopt;
    const ParsedArguments parsed = ParseBatchArguments(QCoreApplication::arguments(), sourceDateEpoch);

    BatchConsole console(BatchConsole::StderrIsTerminal());
    switch (parsed.Outcome) {
    case ParsedArguments::Kind::Help:
        console.Print(BatchHelp());
        return kExitSuccess;
    case ParsedArguments::Kind::UsageError:
        console.Error(parsed.Error);
        console.PrintError(BatchUsage());
        return kExitUsage;
    case ParsedArguments::Kind::Run:
        break;
    }
    return RunBatch(parsed.Arguments, console);
}
