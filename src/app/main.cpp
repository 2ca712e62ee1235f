// Start-up of the desktop program.
#include "common/ProgramFolder.h"

#include <QApplication>
#include <QLabel>

#include <unistd.h>

int main(int argc, char *argv[])
{
    if (geteuid() == 0)
        qputenv("QTWEBENGINE_DISABLE_SANDBOX", "1");
    QCoreApplication::setAttribute(Qt::AA_ShareOpenGLContexts);
    QApplication app(argc, argv);
    verbloom::InitProgramFolder(QCoreApplication::arguments());
    QLabel placeholder(QStringLiteral("Verbloom"));
    placeholder.show();
    return QApplication::exec();
}
