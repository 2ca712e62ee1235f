// verbloom-bench: prints one line per measure.
#include <QCoreApplication>
#include <QTextStream>

int main(int argc, char *argv[])
{
    QCoreApplication app(argc, argv);
    QTextStream out(stdout);
    out << "verbloom-bench\n";
    return 0;
}
