// Atomic replacement of a small file: the old content or the new one, never a mix.
#pragma once

#include <cstddef>
#include <cstdio>
#include <string>

namespace zepapp {

// The file operations an atomic save goes through. Tests derive from the POSIX ones to make
// any step fail. Each operation answers 0 or an errno value.
class ZEPAppFileOps {
public:
  virtual ~ZEPAppFileOps() = default;
  // Creates a new file that must not exist yet. iMode < 0: the usual 0666 less the umask.
  virtual int Create(const std::string& iPath, int iMode, std::FILE*& oFile) = 0;
  virtual int Write(std::FILE* iFile, const char* iData, std::size_t iSize) = 0;
  virtual int Flush(std::FILE* iFile) = 0;
  virtual int Sync(std::FILE* iFile) = 0;
  // Closes in every case, even when it answers an error.
  virtual int Close(std::FILE* iFile) = 0;
  virtual int Rename(const std::string& iFrom, const std::string& iTo) = 0;
  virtual int SyncDir(const std::string& iDir) = 0;
  virtual int Remove(const std::string& iPath) = 0;
};

class ZEPAppPosixFileOps : public ZEPAppFileOps {
public:
  int Create(const std::string& iPath, int iMode, std::FILE*& oFile) override;
  int Write(std::FILE* iFile, const char* iData, std::size_t iSize) override;
  int Flush(std::FILE* iFile) override;
  int Sync(std::FILE* iFile) override;
  int Close(std::FILE* iFile) override;
  int Rename(const std::string& iFrom, const std::string& iTo) override;
  int SyncDir(const std::string& iDir) override;
  int Remove(const std::string& iPath) override;
};

// Replaces iPath by iContent: a temporary file in the same folder is written, flushed and
// synced, renamed over iPath, then the folder is synced. Missing folders are created; a
// symbolic link is followed so that it keeps pointing at the settings. Answers S_OK, or
// E_FAIL with oError saying what failed; before the rename the old file is left untouched,
// and no temporary file is left behind.
long WriteFileAtomically(ZEPAppFileOps& iOps, const std::string& iPath, const std::string& iContent,
                         std::string& oError);

} // namespace zepapp
