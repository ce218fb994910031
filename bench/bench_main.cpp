#include <benchmark/benchmark.h>

#include <QApplication>
#include <QDir>

int main(int argc, char** argv) {
  qputenv("QT_QPA_PLATFORM", "offscreen");
  // What a flush costs is that of a disk, where tests take memory.
  if (!qEnvironmentVariableIsSet("TMPDIR")) qputenv("TMPDIR", QDir::tempPath().toLocal8Bit());
  QApplication app(argc, argv);
  benchmark::Initialize(&argc, argv);
  if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
  benchmark::RunSpecifiedBenchmarks();
  return 0;
}
