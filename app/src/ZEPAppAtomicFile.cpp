#include "ZEPAppAtomicFile.h"

#include "ZEPHostTypes.h"

#include <atomic>
#include <cerrno>
#include <cstring>
#include <filesystem>
#include <system_error>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace fs = std::filesystem;

namespace zepapp {

namespace {
int LastErrno() { return errno ? errno : EIO; }

std::string Why(int iErr) { return std::strerror(iErr); }
} // namespace

int ZEPAppPosixFileOps::Create(const std::string& iPath, int iMode, std::FILE*& oFile) {
  oFile = nullptr;
  int fd = ::open(iPath.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, iMode < 0 ? 0666 : 0600);
  if (fd < 0) return LastErrno();
  // An existing file's permissions carry over: an administrator may have narrowed them.
  if (iMode >= 0 && ::fchmod(fd, static_cast<mode_t>(iMode)) != 0) {
    int err = LastErrno();
    ::close(fd);
    ::unlink(iPath.c_str());
    return err;
  }
  oFile = ::fdopen(fd, "wb");
  if (!oFile) {
    int err = LastErrno();
    ::close(fd);
    ::unlink(iPath.c_str());
    return err;
  }
  return 0;
}

int ZEPAppPosixFileOps::Write(std::FILE* iFile, const char* iData, std::size_t iSize) {
  errno = 0;
  return std::fwrite(iData, 1, iSize, iFile) == iSize ? 0 : LastErrno();
}

int ZEPAppPosixFileOps::Flush(std::FILE* iFile) {
  errno = 0;
  return std::fflush(iFile) == 0 ? 0 : LastErrno();
}

int ZEPAppPosixFileOps::Sync(std::FILE* iFile) { return ::fsync(::fileno(iFile)) == 0 ? 0 : LastErrno(); }

int ZEPAppPosixFileOps::Close(std::FILE* iFile) {
  errno = 0;
  return std::fclose(iFile) == 0 ? 0 : LastErrno();
}

int ZEPAppPosixFileOps::Rename(const std::string& iFrom, const std::string& iTo) {
  return std::rename(iFrom.c_str(), iTo.c_str()) == 0 ? 0 : LastErrno();
}

int ZEPAppPosixFileOps::SyncDir(const std::string& iDir) {
  int fd = ::open(iDir.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
  if (fd < 0) return LastErrno();
  int err = ::fsync(fd) == 0 ? 0 : LastErrno();
  ::close(fd);
  // Some file systems cannot sync a folder at all; that is not a failure of this save.
  return err == EINVAL ? 0 : err;
}

int ZEPAppPosixFileOps::Remove(const std::string& iPath) { return ::unlink(iPath.c_str()) == 0 ? 0 : LastErrno(); }

long WriteFileAtomically(ZEPAppFileOps& iOps, const std::string& iPath, const std::string& iContent,
                         std::string& oError) {
  oError.clear();
  if (iPath.empty()) {
    oError = "no file name to save to";
    return E_FAIL;
  }
  std::error_code ec;
  fs::path target(iPath);
  // Renaming over a symbolic link would replace the link; write where it points instead, even
  // when that file does not exist yet.
  for (int hops = 0; fs::is_symlink(target, ec); ++hops) {
    fs::path next = fs::read_symlink(target, ec);
    if (ec || hops == 40) {
      oError = "cannot follow the link " + target.string() + ": " + (ec ? ec.message() : "too many links");
      return E_FAIL;
    }
    target = next.is_absolute() ? next : target.parent_path() / next;
  }
  fs::path dir = target.parent_path();
  if (dir.empty()) dir = ".";
  if (!fs::exists(dir, ec)) {
    fs::create_directories(dir, ec);
    if (ec) {
      oError = "cannot create the folder " + dir.string() + ": " + ec.message();
      return E_FAIL;
    }
  }
  int mode = -1;
  struct stat st;
  if (::stat(target.c_str(), &st) == 0) mode = static_cast<int>(st.st_mode & 07777);

  static std::atomic<unsigned> counter{0};
  const std::string tmp = (dir / ("." + target.filename().string() + ".tmp." + std::to_string(::getpid()) + "." +
                                  std::to_string(++counter)))
                              .string();
  const std::string unchanged = "; " + target.string() + " is unchanged";

  std::FILE* file = nullptr;
  if (int err = iOps.Create(tmp, mode, file)) {
    oError = "cannot create the temporary file " + tmp + ": " + Why(err) + unchanged;
    return E_FAIL;
  }
  auto fail = [&](const char* iStep, int iErr, bool iOpen) {
    if (iOpen) iOps.Close(file);
    oError = std::string("cannot ") + iStep + " " + tmp + ": " + Why(iErr) + unchanged;
    if (int err = iOps.Remove(tmp)) oError += "; the temporary file could not be removed either: " + Why(err);
    return E_FAIL;
  };
  if (int err = iOps.Write(file, iContent.data(), iContent.size())) return fail("write", err, true);
  if (int err = iOps.Flush(file)) return fail("flush", err, true);
  if (int err = iOps.Sync(file)) return fail("sync", err, true);
  if (int err = iOps.Close(file)) return fail("close", err, false);
  if (int err = iOps.Rename(tmp, target.string())) {
    oError = "cannot rename " + tmp + " to " + target.string() + ": " + Why(err) + unchanged;
    if (int rerr = iOps.Remove(tmp)) oError += "; the temporary file could not be removed either: " + Why(rerr);
    return E_FAIL;
  }
  // The new content is in place but a crash could still bring the old entry back.
  if (int err = iOps.SyncDir(dir.string())) {
    oError = "saved " + target.string() + " but cannot sync its folder " + dir.string() + ": " + Why(err) +
             "; the change may be lost if the system crashes";
    return E_FAIL;
  }
  return S_OK;
}

} // namespace zepapp
