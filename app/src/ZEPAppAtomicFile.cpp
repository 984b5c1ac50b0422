#include "ZEPAppAtomicFile.h"

#include "ZEPHostTypes.h"

#include <algorithm>
#include <chrono>
#include <cstdint>
#include <cerrno>
#include <cstring>
#include <filesystem>
#include <random>
#include <system_error>
#include <thread>

#include <fcntl.h>
#include <sys/file.h>
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
  std::setvbuf(oFile, nullptr, _IONBF, 0); // the content is written whole: one call, no copy
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

namespace {
// What a path that is not a regular file is, for messages.
const char* KindOf(mode_t iMode) {
  if (S_ISDIR(iMode)) return "a folder";
  if (S_ISFIFO(iMode)) return "a FIFO";
  if (S_ISCHR(iMode)) return "a character device";
  if (S_ISBLK(iMode)) return "a block device";
  if (S_ISSOCK(iMode)) return "a socket";
  return "not a regular file";
}

// A name no other writer can guess or have taken: the file's name and twelve random letters.
std::string TemporaryName(const fs::path& iDir, const std::string& iFile) {
  static const char kLetters[] = "abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ0123456789";
  thread_local std::mt19937_64 random{std::random_device{}() ^ (static_cast<std::uint64_t>(::getpid()) << 32)};
  std::string name = "." + iFile + ".tmp.";
  for (int i = 0; i < 12; ++i) name += kLetters[random() % (sizeof kLetters - 1)];
  return (iDir / name).string();
}

std::string TemporaryPrefix(const std::string& iFile) { return "." + iFile + ".tmp."; }
} // namespace

bool ResolveLinks(const std::string& iPath, std::string& oTarget, std::string& oError) {
  std::error_code ec;
  fs::path target(iPath);
  for (int hops = 0; fs::is_symlink(target, ec); ++hops) {
    fs::path next = fs::read_symlink(target, ec);
    if (ec || hops == 40) {
      oError = "cannot follow the link " + target.string() + ": " + (ec ? ec.message() : "too many links");
      return false;
    }
    target = next.is_absolute() ? next : target.parent_path() / next;
  }
  oTarget = target.string();
  return true;
}

bool ReadRegularFile(const std::string& iPath, std::size_t iMaxSize, std::string& oText, bool& oExists,
                     std::string& oError) {
  oText.clear();
  oExists = false;
  // Non-blocking: opening a FIFO must not wait for a writer. The check comes after opening,
  // on what was opened, so that nothing can be swapped in between.
  int fd = ::open(iPath.c_str(), O_RDONLY | O_NONBLOCK | O_NOCTTY | O_CLOEXEC);
  if (fd < 0) {
    if (errno == ENOENT) return true; // first run, or a link to a file not written yet
    oError = "cannot open: " + Why(LastErrno());
    return false;
  }
  oExists = true;
  struct stat st;
  if (::fstat(fd, &st) != 0) {
    oError = "cannot read: " + Why(LastErrno());
    ::close(fd);
    return false;
  }
  if (!S_ISREG(st.st_mode)) {
    oError = std::string("is ") + KindOf(st.st_mode) + ", expected a regular settings file";
    ::close(fd);
    return false;
  }
  // The size fstat tells may be wrong (a file growing meanwhile); the read itself is bounded.
  if (st.st_size > 0) oText.reserve(std::min(static_cast<std::size_t>(st.st_size), iMaxSize));
  char buffer[65536];
  for (;;) {
    const ssize_t n = ::read(fd, buffer, sizeof buffer);
    if (n < 0 && errno == EINTR) continue;
    if (n < 0) {
      oError = "cannot read: " + Why(LastErrno());
      ::close(fd);
      oText.clear();
      return false;
    }
    if (n == 0) break;
    if (oText.size() + static_cast<std::size_t>(n) > iMaxSize) {
      oError = "is larger than " + std::to_string(iMaxSize) + " bytes, too large for a settings file";
      ::close(fd);
      oText.clear();
      return false;
    }
    oText.append(buffer, static_cast<std::size_t>(n));
  }
  ::close(fd);
  return true;
}

bool ZEPAppFileLock::Acquire(const std::string& iTarget, int iTimeoutMs, std::string& oError) {
  Release();
  const std::string path = PathFor(iTarget);
  std::error_code ec;
  fs::path dir = fs::path(iTarget).parent_path();
  if (!dir.empty() && !fs::exists(dir, ec)) {
    fs::create_directories(dir, ec);
    if (ec) {
      oError = "cannot create the folder " + dir.string() + ": " + ec.message();
      return false;
    }
  }
  const int flags = O_CREAT | O_NOFOLLOW | O_NONBLOCK | O_NOCTTY | O_CLOEXEC;
  int fd = ::open(path.c_str(), O_RDWR | flags, 0644);
  if (fd < 0 && errno == EACCES) fd = ::open(path.c_str(), O_RDONLY | flags, 0644); // flock needs no write access
  if (fd < 0) {
    oError = "cannot open the lock file " + path + ": " + Why(LastErrno()) + "; " + iTarget + " is unchanged";
    return false;
  }
  struct stat st;
  if (::fstat(fd, &st) != 0 || !S_ISREG(st.st_mode)) {
    oError = "the lock file " + path + " is not a regular file; " + iTarget + " is unchanged";
    ::close(fd);
    return false;
  }
  const auto deadline = std::chrono::steady_clock::now() + std::chrono::milliseconds(std::max(0, iTimeoutMs));
  auto pause = std::chrono::microseconds(200);
  for (;;) {
    if (::flock(fd, LOCK_EX | LOCK_NB) == 0) break;
    const int err = errno;
    if (err != EWOULDBLOCK && err != EINTR) {
      oError = "cannot lock " + path + ": " + Why(err) + "; " + iTarget + " is unchanged";
      ::close(fd);
      return false;
    }
    if (std::chrono::steady_clock::now() >= deadline) {
      oError = "another process is saving " + iTarget + " (it holds " + path + ") and did not finish within " +
               std::to_string(iTimeoutMs / 1000.0).substr(0, 4) + " s; nothing was written, try again";
      ::close(fd);
      return false;
    }
    std::this_thread::sleep_for(pause);
    pause = std::min(pause * 2, std::chrono::microseconds(2000)); // short: a waiter must not starve
  }
  _fd = fd;
  return true;
}

void ZEPAppFileLock::Release() {
  if (_fd < 0) return;
  ::close(_fd); // closing drops the lock
  _fd = -1;
}

int RemoveStaleTemporaries(const std::string& iTarget) {
  const fs::path target(iTarget);
  const std::string prefix = TemporaryPrefix(target.filename().string());
  fs::path dir = target.parent_path();
  if (dir.empty()) dir = ".";
  std::error_code ec;
  int removed = 0;
  for (fs::directory_iterator it(dir, ec), end; !ec && it != end; it.increment(ec)) {
    const std::string name = it->path().filename().string();
    if (name.compare(0, prefix.size(), prefix) != 0 || name.size() == prefix.size()) continue;
    std::error_code typeEc;
    if (!it->is_regular_file(typeEc) || it->is_symlink(typeEc)) continue;
    if (::unlink(it->path().c_str()) == 0) ++removed;
  }
  return removed;
}

long WriteFileAtomically(ZEPAppFileOps& iOps, const std::string& iPath, const std::string& iContent,
                         std::string& oError) {
  oError.clear();
  if (iPath.empty()) {
    oError = "no file name to save to";
    return E_FAIL;
  }
  // Renaming over a symbolic link would replace the link; write where it points instead, even
  // when that file does not exist yet.
  std::string resolved;
  if (!ResolveLinks(iPath, resolved, oError)) return E_FAIL;
  const fs::path target(resolved);
  fs::path dir = target.parent_path();
  if (dir.empty()) dir = ".";
  std::error_code ec;
  if (!fs::is_directory(dir, ec)) {
    oError = "cannot save " + target.string() + ": the folder " + dir.string() + " does not exist";
    return E_FAIL;
  }
  int mode = -1;
  struct stat st;
  if (::stat(target.c_str(), &st) == 0) {
    if (!S_ISREG(st.st_mode)) {
      oError = target.string() + " is " + KindOf(st.st_mode) + ", not a regular file; it is not replaced";
      return E_FAIL;
    }
    mode = static_cast<int>(st.st_mode & 07777);
  }

  const std::string unchanged = "; " + target.string() + " is unchanged";
  std::string tmp;
  std::FILE* file = nullptr;
  for (int attempt = 0;; ++attempt) {
    tmp = TemporaryName(dir, target.filename().string());
    const int err = iOps.Create(tmp, mode, file);
    if (err == 0) break;
    if (err != EEXIST || attempt == 100) {
      oError = "cannot create the temporary file " + tmp + ": " + Why(err) + unchanged;
      return E_FAIL;
    }
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
