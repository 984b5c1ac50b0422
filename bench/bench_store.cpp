// The settings store beside the libraries desktop programs keep their settings with, on the
// same data: N attributes of one repository, a third doubles, a third ints and a third arrays
// of five doubles (like the grid page's per-range values). Each library is measured through
// its own interface: loading the file, setting every value and saving, and changing one value
// and saving. Peers are measured when the build found them (bench_peers.cpp).
#include "BenchStore.h"
#include "ZEPAppSettingsFile.h"

#include <benchmark/benchmark.h>

#include <cstdlib>
#include <filesystem>
#include <memory>

namespace fs = std::filesystem;
using namespace zepapp;

namespace zepbench {

BenchFolder::BenchFolder() {
  std::string pattern = (fs::temp_directory_path() / "zep_bench_XXXXXX").string();
  if (::mkdtemp(pattern.data())) path = pattern;
}
BenchFolder::~BenchFolder() {
  std::error_code ec;
  if (!path.empty()) fs::remove_all(path, ec);
}

std::string AttributeName(int iIndex) {
  char name[32];
  std::snprintf(name, sizeof name, "Drw_Attr%06d", iIndex);
  return name;
}

} // namespace zepbench

using namespace zepbench;

namespace {

// The store's file of N attributes, written by the store itself; iRound varies the values.
ZEPAppSettingsDoc SampleDoc(int iCount, int iRound) {
  ZEPAppSettingsDoc doc;
  ZEPAppRepoEntries& entries = doc.settings[kBenchRepository];
  for (int i = 0; i < iCount; ++i) {
    ZEPAppAttrEntry& e = entries[AttributeName(i)];
    switch (KindOf(i)) {
    case BenchKind::Double: e.value = std::vector<double>{DoubleValue(i, iRound)}; break;
    case BenchKind::Int: e.value = std::vector<int>{IntValue(i, iRound)}; break;
    case BenchKind::Array: {
      std::vector<double> v(5);
      ArrayValue(i, iRound, v.data());
      e.value = std::move(v);
    }
    }
  }
  return doc;
}

void WriteSample(const std::string& iFile, int iCount) {
  std::string text, err;
  FormatSettingsText(SampleDoc(iCount, 0), false, text, err);
  ZEPAppPosixFileOps ops;
  WriteFileAtomically(ops, iFile, text, err);
}

// Sets every attribute of the repository to the values of iRound.
void WriteAll(ZEPSysSettingRepository& ioRepo, int iCount, int iRound) {
  for (int i = 0; i < iCount; ++i) {
    const std::string name = AttributeName(i);
    switch (KindOf(i)) {
    case BenchKind::Double: {
      const double v = DoubleValue(i, iRound);
      ioRepo.WriteAttr(name.c_str(), &v, 1);
      break;
    }
    case BenchKind::Int: {
      const int v = IntValue(i, iRound);
      ioRepo.WriteAttr(name.c_str(), &v, 1);
      break;
    }
    case BenchKind::Array: {
      double v[5];
      ArrayValue(i, iRound, v);
      ioRepo.WriteAttr(name.c_str(), v, 5);
    }
    }
  }
}

// A store loaded from a sample file of N attributes, with the benchmark's repository open.
struct LoadedStore {
  explicit LoadedStore(int iCount) : file((folder.path / "settings.json").string()) {
    WriteSample(file, iCount);
    ZEPSysSettingRepository::CloseAll();
    store.Load(file);
    repo = store.OpenSettings(kBenchRepository);
  }
  ~LoadedStore() { ZEPSysSettingRepository::CloseAll(); }
  BenchFolder folder;
  std::string file;
  ZEPAppSettingsFile store;
  ZEPSysSettingRepository* repo = nullptr;
};

void Store_Load(benchmark::State& state) {
  BenchFolder folder;
  const std::string file = (folder.path / "settings.json").string();
  const int n = static_cast<int>(state.range(0));
  WriteSample(file, n);
  for (auto _ : state) {
    auto store = std::make_unique<ZEPAppSettingsFile>();
    if (FAILED(store->Load(file))) state.SkipWithError(store->LastError().c_str());
    state.PauseTiming(); // as for the peers, what is freed is not measured
    store.reset();
    ZEPSysSettingRepository::CloseAll();
    state.ResumeTiming();
  }
}

void Store_SaveAll(benchmark::State& state) {
  const int n = static_cast<int>(state.range(0));
  LoadedStore loaded(n);
  ZEPAppSettingsFile& store = loaded.store;
  ZEPSysSettingRepository* repo = loaded.repo;
  int round = 0;
  for (auto _ : state) {
    WriteAll(*repo, n, ++round);
    if (FAILED(repo->SaveRepository())) state.SkipWithError(store.LastError().c_str());
  }
}

void Store_ChangeOneAndSave(benchmark::State& state) {
  const int n = static_cast<int>(state.range(0));
  LoadedStore loaded(n);
  ZEPAppSettingsFile& store = loaded.store;
  ZEPSysSettingRepository* repo = loaded.repo;
  const std::string name = AttributeName(n / 2 / 3 * 3 + 1); // an int in the middle
  int round = 0;
  for (auto _ : state) {
    const int v = ++round;
    repo->WriteAttr(name.c_str(), &v, 1);
    if (FAILED(repo->SaveRepository())) state.SkipWithError(store.LastError().c_str());
  }
}

// One save of a page's size: the read-modify-write under the file's lock beside the plain
// atomic replacement it wraps.
void Store_PageSaveUnlocked(benchmark::State& state) {
  BenchFolder folder;
  const std::string file = (folder.path / "settings.json").string();
  ZEPAppSettingsDoc doc = SampleDoc(20, 0);
  ZEPAppPosixFileOps ops;
  int round = 0;
  for (auto _ : state) {
    doc.settings[kBenchRepository][AttributeName(1)].value = std::vector<int>{++round};
    std::string text, err;
    FormatSettingsText(doc, false, text, err);
    if (FAILED(WriteFileAtomically(ops, file, text, err))) state.SkipWithError(err.c_str());
  }
}

void Store_PageSaveLocked(benchmark::State& state) {
  state.SetLabel("20 attributes");
  LoadedStore loaded(20);
  ZEPAppSettingsFile& store = loaded.store;
  ZEPSysSettingRepository* repo = loaded.repo;
  int round = 0;
  for (auto _ : state) {
    const int v = ++round;
    repo->WriteAttr(AttributeName(1).c_str(), &v, 1);
    if (FAILED(repo->SaveRepository())) state.SkipWithError(store.LastError().c_str());
  }
}

// Registered by size, then by operation, ours first, so that each size's figures come together.
const int kRegistered = [] {
  for (int n : {1000, 10000, 100000}) {
    for (const auto& [operation, store] :
         {std::pair{"Load", &Store_Load}, {"SaveAll", &Store_SaveAll}, {"ChangeOneAndSave", &Store_ChangeOneAndSave}}) {
      benchmark::RegisterBenchmark((std::string(operation) + "/Store").c_str(), store)
          ->Arg(n)
          ->Unit(benchmark::kMillisecond);
      RegisterPeers(operation, n);
    }
  }
  benchmark::RegisterBenchmark("PageSave/Unlocked", Store_PageSaveUnlocked)->Unit(benchmark::kMicrosecond);
  benchmark::RegisterBenchmark("PageSave/Locked", Store_PageSaveLocked)->Unit(benchmark::kMicrosecond);
  return 0;
}();

} // namespace
