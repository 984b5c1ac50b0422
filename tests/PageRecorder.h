// A recording host for the options pages, generated from each page's attribute table:
// getters answer scripted values (or fall back to the module's own bodies), info hooks
// answer scripted statuses and lock states, and every setter call is recorded in order.
#pragma once

#include "TestSupport.h"
#include "ZEPDrwSettingHooks.h"

#include <map>
#include <set>
#include <string>
#include <vector>

struct HookCall {
  std::string hook;           // "SetSysDisplayGrid"
  std::vector<double> values; // numbers as written (arrays whole, colours as three)
  std::string text;           // texts
};

class HookScript {
public:
  // Getter values by attribute name; attributes not scripted use the module's bodies.
  std::map<std::string, std::vector<double>> values;
  std::map<std::string, std::string> texts;
  std::map<std::string, std::vector<std::string>> textLists;
  // Info statuses by attribute; allInfo applies to every other attribute when set.
  std::map<std::string, long> info;
  bool allInfoSet = false;
  long allInfo = 0;
  std::set<std::string> locked;
  // Answers of layout options and other page operations by name; unscripted ones keep the
  // module's answer.
  std::map<std::string, long> options;
  // Text answers of page operations by name (icon names, a default standard); "" unscripted.
  std::map<std::string, std::string> answers;
  std::vector<HookCall> calls;
  std::vector<std::string> reads; // getters called, in order

  // The hooks called, in order.
  std::vector<std::string> Hooks() const {
    std::vector<std::string> out;
    for (const HookCall& c : calls) out.push_back(c.hook);
    return out;
  }
  std::vector<HookCall> Calls(const std::string& iHook) const {
    std::vector<HookCall> out;
    for (const HookCall& c : calls)
      if (c.hook == iHook) out.push_back(c);
    return out;
  }

  // When set, the getters answer what the setters wrote last: a host that keeps its settings,
  // for pages that read a setting back after writing it.
  bool storeWrites = false;

  template <class T> void Record(const char* iHook, const T& iValue) {
    calls.push_back({iHook, {double(iValue)}, {}});
    Store(calls.back());
  }
  void Record(const char* iHook, const ZEPUnicodeString& iValue) {
    calls.push_back({iHook, {}, iValue.str()});
    if (storeWrites) texts[Attribute(iHook)] = iValue.str();
  }
  void Record(const char* iHook, const ZEPListValZEPUnicodeString& iValue) {
    HookCall c{iHook, {}, {}};
    std::vector<std::string> items;
    for (const ZEPUnicodeString& s : iValue.Items()) {
      c.text += s.str() + "\n";
      items.push_back(s.str());
    }
    calls.push_back(c);
    if (storeWrites) textLists[Attribute(iHook)] = items;
  }
  template <class T> void Record(const char* iHook, const T* iValues, int iCount) {
    calls.push_back({iHook, std::vector<double>(iValues, iValues + iCount), {}});
    Store(calls.back());
  }
  template <class T> void Record(const char* iHook, const T& iRed, const T& iGreen, const T& iBlue) {
    calls.push_back({iHook, {double(iRed), double(iGreen), double(iBlue)}, {}});
    Store(calls.back());
  }
  // The attribute of a setter: its name after "SetSys".
  static std::string Attribute(const std::string& iSetter) { return iSetter.substr(6); }
  void Store(const HookCall& iCall) {
    if (storeWrites) values[Attribute(iCall.hook)] = iCall.values;
  }

  // True when the attribute is scripted and the outputs were filled.
  template <class T> bool Fill(const char* iName, T& oValue) {
    reads.push_back(iName);
    auto it = values.find(iName);
    if (it == values.end() || it->second.empty()) return false;
    oValue = static_cast<T>(it->second[0]);
    return true;
  }
  bool Fill(const char* iName, ZEPUnicodeString& oValue) {
    reads.push_back(iName);
    auto it = texts.find(iName);
    if (it == texts.end()) return false;
    oValue = it->second;
    return true;
  }
  bool Fill(const char* iName, ZEPListValZEPUnicodeString& oValue) {
    reads.push_back(iName);
    auto it = textLists.find(iName);
    if (it == textLists.end()) return false;
    oValue.RemoveAll(1);
    for (const std::string& s : it->second)
      oValue.Append(ZEPUnicodeString(s));
    return true;
  }
  template <class T> bool Fill(const char* iName, T* oValues, int iCount) {
    reads.push_back(iName);
    auto it = values.find(iName);
    if (it == values.end()) return false;
    for (int i = 0; i < iCount && i < static_cast<int>(it->second.size()); ++i) oValues[i] = static_cast<T>(it->second[i]);
    return true;
  }
  template <class T> bool Fill(const char* iName, T& oRed, T& oGreen, T& oBlue) {
    reads.push_back(iName);
    auto it = values.find(iName);
    if (it == values.end() || it->second.size() < 3) return false;
    oRed = static_cast<T>(it->second[0]);
    oGreen = static_cast<T>(it->second[1]);
    oBlue = static_cast<T>(it->second[2]);
    return true;
  }

  // The scripted answer of operation iName, else iModule (the module's own answer).
  long Option(const char* iName, long iModule) const {
    auto it = options.find(iName);
    return it == options.end() ? iModule : it->second;
  }

  std::string Answer(const char* iName) const {
    auto it = answers.find(iName);
    return it == answers.end() ? std::string() : it->second;
  }

  // True and the status when the attribute's info hook is scripted.
  bool Info(const char* iName, ZEPSettingInfo& oInfo, long& oStatus) const {
    auto it = info.find(iName);
    if (it == info.end() && !allInfoSet) return false;
    oStatus = it == info.end() ? allInfo : it->second;
    oInfo.SetLocked(locked.count(iName) != 0);
    oInfo.SetLockText(oInfo.IsLocked() ? "test administrator" : "");
    return true;
  }
};

// Base of the generated recording pages: forwards the page's protected constructor.
template <class Page> class Recording : public Page {
public:
  using RecordedPage = Page;
  template <class... A>
  explicit Recording(HookScript& iScript, A&&... iArgs) : Page(std::forward<A>(iArgs)...), _script(iScript) {}

protected:
  HookScript& _script;
};

#define ZEP_RECORD_SETTING_HOOKS(Name, Kind)                                                        \
  long SetSys##Name(ZEP_SETPARAMS(Kind)) override {                                                 \
    this->_script.Record("SetSys" #Name, ZEP_SETARGS(Kind));                                        \
    return S_OK;                                                                                    \
  }                                                                                                 \
  long GetSys##Name(ZEP_GETPARAMS(Kind)) override {                                                 \
    if (!this->_script.Fill(#Name, ZEP_GETARGS(Kind))) return this->RecordedPage::GetSys##Name(ZEP_GETARGS(Kind)); \
    return S_OK;                                                                                    \
  }                                                                                                 \
  long GetSys##Name##Info(ZEPSettingInfo& oInfo) override {                                         \
    long status = 0;                                                                                \
    if (!this->_script.Info(#Name, oInfo, status)) return this->RecordedPage::GetSys##Name##Info(oInfo);          \
    return status;                                                                                  \
  }
