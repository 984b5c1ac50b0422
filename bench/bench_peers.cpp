// The peers of the store benchmark, on the data of BenchStore.h: GLib's GKeyFile and Qt's
// QSettings (INI), each when the build found it.
#include "BenchStore.h"

#include <benchmark/benchmark.h>

#include <cstdio>
#include <vector>

#ifdef ZEP_BENCH_GKEYFILE
#include <glib.h>
#endif
#ifdef ZEP_BENCH_QSETTINGS
#include <QSettings>
#include <QString>
#include <QVariant>
#include <fcntl.h>
#include <sys/stat.h>
#endif

namespace zepbench {
namespace {

#ifdef ZEP_BENCH_GKEYFILE
void SetAll(GKeyFile* ioFile, int iCount, int iRound) {
  for (int i = 0; i < iCount; ++i) {
    const std::string name = AttributeName(i);
    switch (KindOf(i)) {
    case BenchKind::Double: g_key_file_set_double(ioFile, kBenchRepository, name.c_str(), DoubleValue(i, iRound)); break;
    case BenchKind::Int: g_key_file_set_integer(ioFile, kBenchRepository, name.c_str(), IntValue(i, iRound)); break;
    case BenchKind::Array: {
      double v[5];
      ArrayValue(i, iRound, v);
      g_key_file_set_double_list(ioFile, kBenchRepository, name.c_str(), v, 5);
    }
    }
  }
}

bool Save(GKeyFile* iFile, const std::string& iPath, benchmark::State& state) {
  GError* error = nullptr;
  if (g_key_file_save_to_file(iFile, iPath.c_str(), &error)) return true;
  state.SkipWithError(error ? error->message : "g_key_file_save_to_file failed");
  if (error) g_error_free(error);
  return false;
}

std::string WriteSample(const BenchFolder& iFolder, int iCount, benchmark::State& state) {
  const std::string path = (iFolder.path / "settings.ini").string();
  GKeyFile* file = g_key_file_new();
  SetAll(file, iCount, 0);
  Save(file, path, state);
  g_key_file_free(file);
  return path;
}

GKeyFile* Load(const std::string& iPath, benchmark::State& state) {
  GKeyFile* file = g_key_file_new();
  GError* error = nullptr;
  if (!g_key_file_load_from_file(file, iPath.c_str(), G_KEY_FILE_NONE, &error)) {
    state.SkipWithError(error ? error->message : "g_key_file_load_from_file failed");
    if (error) g_error_free(error);
  }
  return file;
}

void GKeyFile_Load(benchmark::State& state) {
  BenchFolder folder;
  const std::string path = WriteSample(folder, static_cast<int>(state.range(0)), state);
  for (auto _ : state) {
    GKeyFile* file = Load(path, state);
    state.PauseTiming();
    g_key_file_free(file);
    state.ResumeTiming();
  }
}

void GKeyFile_SaveAll(benchmark::State& state) {
  BenchFolder folder;
  const int n = static_cast<int>(state.range(0));
  const std::string path = WriteSample(folder, n, state);
  GKeyFile* file = Load(path, state);
  int round = 0;
  for (auto _ : state) {
    SetAll(file, n, ++round);
    if (!Save(file, path, state)) break;
  }
  g_key_file_free(file);
}

void GKeyFile_ChangeOneAndSave(benchmark::State& state) {
  BenchFolder folder;
  const int n = static_cast<int>(state.range(0));
  const std::string path = WriteSample(folder, n, state);
  GKeyFile* file = Load(path, state);
  const std::string name = AttributeName(n / 2 / 3 * 3 + 1);
  int round = 0;
  for (auto _ : state) {
    g_key_file_set_integer(file, kBenchRepository, name.c_str(), ++round);
    if (!Save(file, path, state)) break;
  }
  g_key_file_free(file);
}
#endif

#ifdef ZEP_BENCH_QSETTINGS
QString Key(int iIndex) { return QString::fromLatin1(kBenchRepository) + '/' + QString::fromStdString(AttributeName(iIndex)); }

void SetAll(QSettings& ioSettings, int iCount, int iRound) {
  for (int i = 0; i < iCount; ++i) {
    switch (KindOf(i)) {
    case BenchKind::Double: ioSettings.setValue(Key(i), DoubleValue(i, iRound)); break;
    case BenchKind::Int: ioSettings.setValue(Key(i), IntValue(i, iRound)); break;
    case BenchKind::Array: {
      double v[5];
      ArrayValue(i, iRound, v);
      ioSettings.setValue(Key(i), QVariantList{v[0], v[1], v[2], v[3], v[4]});
    }
    }
  }
}

QString WriteSample(const BenchFolder& iFolder, int iCount) {
  const QString path = QString::fromStdString((iFolder.path / "settings.ini").string());
  QSettings settings(path, QSettings::IniFormat);
  SetAll(settings, iCount, 0);
  settings.sync();
  return path;
}

bool Saved(QSettings& iSettings, benchmark::State& state) {
  iSettings.sync();
  if (iSettings.status() == QSettings::NoError) return true;
  state.SkipWithError("QSettings::sync failed");
  return false;
}

// QSettings keeps recently parsed files in memory while they are unchanged on disk: a new
// modification time for each round makes every load read the file.
void Touch(const QString& iPath, long iRound) {
  const struct timespec times[2] = {{iRound, 0}, {iRound, 0}};
  ::utimensat(AT_FDCWD, iPath.toLocal8Bit().constData(), times, 0);
}

void QSettings_Load(benchmark::State& state) {
  BenchFolder folder;
  const QString path = WriteSample(folder, static_cast<int>(state.range(0)));
  long round = 1000000;
  for (auto _ : state) {
    state.PauseTiming();
    Touch(path, ++round);
    state.ResumeTiming();
    auto* settings = new QSettings(path, QSettings::IniFormat);
    benchmark::DoNotOptimize(settings->value(Key(0)));
    state.PauseTiming();
    delete settings;
    state.ResumeTiming();
  }
}

void QSettings_SaveAll(benchmark::State& state) {
  BenchFolder folder;
  const int n = static_cast<int>(state.range(0));
  QSettings settings(WriteSample(folder, n), QSettings::IniFormat);
  int round = 0;
  for (auto _ : state) {
    SetAll(settings, n, ++round);
    if (!Saved(settings, state)) break;
  }
}

void QSettings_ChangeOneAndSave(benchmark::State& state) {
  BenchFolder folder;
  const int n = static_cast<int>(state.range(0));
  QSettings settings(WriteSample(folder, n), QSettings::IniFormat);
  const QString key = Key(n / 2 / 3 * 3 + 1);
  int round = 0;
  for (auto _ : state) {
    settings.setValue(key, ++round);
    if (!Saved(settings, state)) break;
  }
}
#endif

void Register(const std::string& iName, void (*iFunction)(benchmark::State&), int iCount) {
  benchmark::RegisterBenchmark(iName.c_str(), iFunction)->Arg(iCount)->Unit(benchmark::kMillisecond);
}

} // namespace

void RegisterPeers(const std::string& iOperation, int iCount) {
#ifdef ZEP_BENCH_GKEYFILE
  if (iOperation == "Load") Register("Load/GKeyFile", GKeyFile_Load, iCount);
  if (iOperation == "SaveAll") Register("SaveAll/GKeyFile", GKeyFile_SaveAll, iCount);
  if (iOperation == "ChangeOneAndSave") Register("ChangeOneAndSave/GKeyFile", GKeyFile_ChangeOneAndSave, iCount);
#endif
#ifdef ZEP_BENCH_QSETTINGS
  if (iOperation == "Load") Register("Load/QSettings", QSettings_Load, iCount);
  if (iOperation == "SaveAll") Register("SaveAll/QSettings", QSettings_SaveAll, iCount);
  if (iOperation == "ChangeOneAndSave") Register("ChangeOneAndSave/QSettings", QSettings_ChangeOneAndSave, iCount);
#endif
  (void)iOperation, (void)iCount;
}

} // namespace zepbench
