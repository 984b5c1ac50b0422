// Saving the user's settings: the read-modify-write under the file's lock beside the plain
// atomic replacement it wraps, on a file of a page's size.
#include "ZEPAppSettingsFile.h"

#include <benchmark/benchmark.h>

#include <cstdlib>
#include <filesystem>

namespace fs = std::filesystem;
using namespace zepapp;

namespace {

struct Folder {
  Folder() {
    std::string pattern = (fs::temp_directory_path() / "zep_bench_XXXXXX").string();
    if (::mkdtemp(pattern.data())) path = pattern;
  }
  ~Folder() {
    std::error_code ec;
    if (!path.empty()) fs::remove_all(path, ec);
  }
  fs::path path;
};

// Twenty attributes, grid-like: per-range doubles and ints, and flags.
ZEPAppSettingsDoc SampleDoc() {
  ZEPAppSettingsDoc doc;
  for (int i = 0; i < 20; ++i) {
    ZEPAppAttrEntry& e = doc.settings["DrwSketcherSpecific"]["Attr" + std::to_string(i)];
    if (i % 3 == 0) e.value = std::vector<double>{100.0 + i, 10000.0, 1e6, 1.0, 0.01};
    else if (i % 3 == 1) e.value = std::vector<int>{10, 10, 10, 10, i};
    else e.value = std::vector<int>{i % 2};
  }
  return doc;
}

void BM_SaveUnlocked(benchmark::State& state) {
  Folder folder;
  const std::string file = (folder.path / "settings.json").string();
  ZEPAppSettingsDoc doc = SampleDoc();
  ZEPAppPosixFileOps ops;
  int round = 0;
  for (auto _ : state) {
    doc.settings["DrwSketcherSpecific"]["Attr1"].value = std::vector<int>{10, 10, 10, 10, ++round};
    std::string text, err;
    FormatSettingsText(doc, false, text, err);
    if (FAILED(WriteFileAtomically(ops, file, text, err))) state.SkipWithError(err.c_str());
  }
}
BENCHMARK(BM_SaveUnlocked)->Unit(benchmark::kMicrosecond);

void BM_SaveLocked(benchmark::State& state) {
  Folder folder;
  const std::string file = (folder.path / "settings.json").string();
  std::string text, err;
  FormatSettingsText(SampleDoc(), false, text, err);
  ZEPAppPosixFileOps ops;
  WriteFileAtomically(ops, file, text, err);
  ZEPSysSettingRepository::CloseAll();
  ZEPAppSettingsFile store;
  store.Load(file);
  ZEPSysSettingRepository* repo = store.OpenSettings("DrwSketcherSpecific");
  int round = 0;
  for (auto _ : state) {
    const int values[5] = {10, 10, 10, 10, ++round};
    repo->WriteAttr("Attr1", values, 5);
    if (FAILED(repo->SaveRepository())) state.SkipWithError(store.LastError().c_str());
  }
  ZEPSysSettingRepository::CloseAll();
}
BENCHMARK(BM_SaveLocked)->Unit(benchmark::kMicrosecond);

} // namespace
