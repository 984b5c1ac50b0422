// The data the store benchmark measures every library on.
#pragma once

#include <filesystem>
#include <string>

namespace zepbench {

inline constexpr const char* kBenchRepository = "DrwSketcherSpecific";

enum class BenchKind { Double, Int, Array };
inline BenchKind KindOf(int iIndex) { return static_cast<BenchKind>(iIndex % 3); }
// Values of attribute iIndex in round iRound: every round changes every value.
inline double DoubleValue(int iIndex, int iRound) { return 0.25 * iIndex + 1000.5 * iRound + 0.1; }
inline int IntValue(int iIndex, int iRound) { return iIndex * 7 + iRound; }
inline void ArrayValue(int iIndex, int iRound, double* oFive) {
  const double base[5] = {100.0, 10000.0, 1e6, 1.0, 0.01};
  for (int k = 0; k < 5; ++k) oFive[k] = base[k] * (1 + iIndex % 10) + iRound * 0.5;
}
std::string AttributeName(int iIndex);

// A temporary folder, removed with what it holds.
struct BenchFolder {
  BenchFolder();
  ~BenchFolder();
  std::filesystem::path path;
};

// Registers the peers' benchmarks of one operation ("Load", "SaveAll", "ChangeOneAndSave")
// at iCount attributes, for the peers this build has.
void RegisterPeers(const std::string& iOperation, int iCount);

} // namespace zepbench
