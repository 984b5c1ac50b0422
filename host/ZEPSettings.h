// Settings: lock information, the padlock widget, setting and preference repositories.
#pragma once

#include "ZEPDialog.h"

#include <functional>
#include <map>
#include <memory>
#include <string>
#include <variant>
#include <vector>

// Lock information of one setting, filled by an info hook.
class ZEPSettingInfo {
public:
  ZEPSettingInfo() = default;
  void SetLocked(bool iLocked) { _locked = iLocked; }
  bool IsLocked() const { return _locked; }
  // Who locked the setting and where, shown by the padlock.
  void SetLockText(const std::string& iText) { _lockText = iText; }
  const std::string& GetLockText() const { return _lockText; }
  void Reset() {
    _locked = false;
    _lockText.clear();
  }

private:
  bool _locked = false;
  std::string _lockText;
};

// The padlock widget: stands for the lock state of one setting and keeps the widgets
// associated with it disabled while the setting is locked.
class ZEPDlgLock : public ZEPDialog {
  ZEP_DECLARE_CLASS
public:
  ZEPDlgLock(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo, unsigned long iStyle = 0);
  ~ZEPDlgLock() override;

  void AddAssociatedDialog(ZEPDialog* iDialog);
  void RemoveAssociatedDialog(ZEPDialog* iDialog);
  // oSensitivity: 16 while locked (the widget must stay disabled), else 8.
  long GetAssociatedDialogSensitivity(unsigned long& oSensitivity) const;

  bool IsLocked() const { return _info.IsLocked(); }
  const std::string& GetLockText() const { return _info.GetLockText(); }
  // Locking disables the associated widgets; unlocking gives them back to their page.
  void SetLocked(bool iLocked);

  const char* KindName() const override { return "padlock"; }
  void DumpState(std::string& ioOut) const override;

private:
  ZEPSettingInfo _info;
  std::vector<ZEPDialog*> _associated;
};

// Typed attributes kept in memory, in two layers: values written by the user, and an
// administrator's layer of defaults and locks. A default is not a lock. A locked
// attribute reads the administrator's value and refuses writes.
class ZEPSysSettingRepository {
public:
  // Numbers, or texts (one text, or a list of texts that may be empty).
  using Value = std::variant<std::vector<double>, std::vector<int>, std::vector<unsigned int>, std::vector<std::string>>;
  struct Lock {
    bool locked = false;
    std::string text; // who and where
  };

  explicit ZEPSysSettingRepository(std::string iName) : _name(std::move(iName)) {}
  virtual ~ZEPSysSettingRepository() = default;
  ZEPSysSettingRepository(const ZEPSysSettingRepository&) = delete;
  ZEPSysSettingRepository& operator=(const ZEPSysSettingRepository&) = delete;

  // The named repository, or null when none is open.
  static ZEPSysSettingRepository* GetRepository(const char* iName, int iFlag = 0);
  // Opens (creates when needed) a repository of the registry; it lives until Close.
  static ZEPSysSettingRepository* Open(const std::string& iName);
  static void Close(const std::string& iName);
  static void CloseAll();

  const std::string& GetName() const { return _name; }

  // Number of values read (up to iCount); the caller's values stay where fewer are read.
  // An attribute of another type reads nothing.
  int ReadAttr(const char* iName, double* oValues, int iCount = 1) const;
  int ReadAttr(const char* iName, int* oValues, int iCount = 1) const;
  int ReadAttr(const char* iName, unsigned int* oValues, int iCount = 1) const;
  // 1 on success; 0 when refused (locked attribute, bad arguments).
  int WriteAttr(const char* iName, const double* iValues, int iCount = 1);
  int WriteAttr(const char* iName, const int* iValues, int iCount = 1);
  int WriteAttr(const char* iName, const unsigned int* iValues, int iCount = 1);
  // Texts: the number of texts read, -1 when the attribute holds no texts (oTexts unchanged).
  int ReadAttr(const char* iName, std::vector<std::string>& oTexts) const;
  // 1 on success; 0 when refused (locked attribute, no name, a text that is not UTF-8 or holds a NUL).
  int WriteAttr(const char* iName, const std::vector<std::string>& iTexts);
  // Negative on failure. Nothing to save (no change since the last save) is a success.
  long SaveRepository(const char* iName = nullptr);

  // Administrator's layer.
  void SetDefault(const std::string& iName, const Value& iValue);
  void SetLock(const std::string& iName, bool iLocked, const std::string& iText = "");
  bool IsLocked(const std::string& iName) const;
  // Fills the lock information of an attribute; answers S_OK.
  long GetLockInfo(const std::string& iName, ZEPSettingInfo& oInfo) const;

  // User's layer.
  bool HasUserValue(const std::string& iName) const { return _user.count(iName) != 0; }
  // Drops the user's value: the attribute reads its default again. 0 when locked.
  int ResetAttr(const std::string& iName);
  void SetUserValue(const std::string& iName, const Value& iValue); // loading, not a change
  // Loading many at once: taken whole (no copy) when the user's layer is empty, else merged in.
  void SetUserValues(std::map<std::string, Value>&& iValues);

  const std::map<std::string, Value>& UserValues() const { return _user; }
  // The names of the user's values written or reset (WriteAttr, ResetAttr) since ForgetWrites,
  // in the order of the writes, possibly repeated: where a store looks for what changed rather
  // than comparing every value. Null when that is not known: before the first ForgetWrites,
  // after loading (SetUserValue, SetUserValues), or once more were written than are kept.
  const std::vector<std::string>* Written() const { return _writtenKnown ? &_written : nullptr; }
  // Starts the list again, empty; iKeep false: no list is kept until the next ForgetWrites.
  void ForgetWrites(bool iKeep = true) {
    _written.clear();
    _writtenKnown = iKeep;
  }
  const std::map<std::string, Value>& Defaults() const { return _defaults; }
  const std::map<std::string, Lock>& Locks() const { return _locks; }
  // The value a read answers (administrator's when locked, else user's, else default); null if none.
  const Value* Effective(const std::string& iName) const;

  bool IsModified() const { return _modified; }
  // Writes the repository somewhere; answers a status. Without one, saving keeps memory only.
  void SetSaveHandler(std::function<long(ZEPSysSettingRepository&)> iHandler) { _saveHandler = std::move(iHandler); }

protected:
  template <class T> int Read(const char* iName, T* oValues, int iCount) const;
  template <class T> int Write(const char* iName, const T* iValues, int iCount);
  template <class T> int Store(const char* iName, std::vector<T>&& iValues);
  void NoteWrite(const char* iName);

private:
  std::string _name;
  std::map<std::string, Value> _user;
  std::map<std::string, Value> _defaults;
  std::map<std::string, Lock> _locks;
  bool _modified = false;
  std::vector<std::string> _written;
  bool _writtenKnown = false;
  std::function<long(ZEPSysSettingRepository&)> _saveHandler;
};

// The user's preferences (window places and the like): int values by key.
class ZEPSysPreferenceRepository : public ZEPSysSettingRepository {
public:
  explicit ZEPSysPreferenceRepository(std::string iName) : ZEPSysSettingRepository(std::move(iName)) {}
  static ZEPSysPreferenceRepository* GetPreferenceRepository(const char* iName);
  static ZEPSysPreferenceRepository* Open(const std::string& iName);
  static void Close(const std::string& iName);
  static void CloseAll();
  int ReadPreference(const char* iKey, int* oValues, int iCount = 1) const { return ReadAttr(iKey, oValues, iCount); }
  int WritePreference(const char* iKey, const int* iValues, int iCount = 1) { return WriteAttr(iKey, iValues, iCount); }
};
