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

// The file a path names, symbolic links followed (also to a file that does not exist yet), so
// that a save replaces the file a link points at rather than the link. False with oError.
bool ResolveLinks(const std::string& iPath, std::string& oTarget, std::string& oError);

// Reads a settings file. It is opened without blocking and checked after opening, so that a
// FIFO, device, socket or folder is refused (with its path) rather than waited on or read; at
// most iMaxSize bytes are read however large the file claims to be. A missing file is no error:
// oExists false and empty text. False otherwise, with oError saying why after the path
// ("is a FIFO, expected a regular settings file").
bool ReadRegularFile(const std::string& iPath, std::size_t iMaxSize, std::string& oText, bool& oExists,
                     std::string& oError);

// An advisory lock (flock) on a lock file beside a file that several processes replace: the
// file's name with ".lock" added, in the same folder. The lock file stays in place: removing it
// would let a waiting process lock a file that is no longer the lock. Released when destroyed.
class ZEPAppFileLock {
public:
  ZEPAppFileLock() = default;
  ~ZEPAppFileLock() { Release(); }
  ZEPAppFileLock(const ZEPAppFileLock&) = delete;
  ZEPAppFileLock& operator=(const ZEPAppFileLock&) = delete;

  // Locks for iTarget (a path with links already followed), waiting up to iTimeoutMs. The
  // target's folder is created when missing. False with oError when the lock could not be had.
  bool Acquire(const std::string& iTarget, int iTimeoutMs, std::string& oError);
  void Release();
  bool Held() const { return _fd >= 0; }
  static std::string PathFor(const std::string& iTarget) { return iTarget + ".lock"; }

private:
  int _fd = -1;
};

// Removes the temporary files that an interrupted save of iTarget left in its folder. Only
// call it while holding iTarget's lock: every writer creates its temporary file under the lock,
// so any one found then belongs to a writer that died. Answers how many were removed.
int RemoveStaleTemporaries(const std::string& iTarget);

// Replaces iPath by iContent: a temporary file with an unpredictable name in the same folder is
// written, flushed and synced, renamed over iPath, then the folder is synced. A symbolic link
// is followed so that it keeps pointing at the file. Missing folders are not created, and only
// a regular file is replaced (a FIFO or device is refused). Answers S_OK, or E_FAIL with oError
// saying what failed; before the rename the old file is left untouched, and no temporary file
// is left behind.
long WriteFileAtomically(ZEPAppFileOps& iOps, const std::string& iPath, const std::string& iContent,
                         std::string& oError);

} // namespace zepapp
