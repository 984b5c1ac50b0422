// A control bound to one setting: a padlock in column 0 and the real toolkit control
// (the inner control) in column 1. While the setting is locked the page cannot enable it.
#pragma once

#include "ZEPHost.h"

class ZEPDrwLockDialog : public ZEPDlgFrame {
public:
  // Creates the frame and its padlock N + "Lock"; the subclass creates the inner control.
  ZEPDrwLockDialog(ZEPDialog* iParent, const ZEPString& iName, const ZEPSettingInfo& iInfo);
  ~ZEPDrwLockDialog() override;
  // Widgets are tree nodes owned by their parent: not copyable.
  ZEPDrwLockDialog(const ZEPDrwLockDialog&) = delete;
  ZEPDrwLockDialog& operator=(const ZEPDrwLockDialog&) = delete;

  // The inner control's name when there is one (N + "_dialog"), else the frame's.
  ZEPString GetName() const override;
  // The inner control: the sender of every notification a page receives from this control.
  virtual ZEPDialog* GetDialog() const;

  // The padlock decides first: while it imposes 16 the request is ignored.
  void SetSensitivity(unsigned long iSensitivity);
  unsigned long GetSensitivity() const;

  void SetTitle(const ZEPUnicodeString& iText);
  void SetHelp(const ZEPUnicodeString& iText);
  void SetShortHelp(const ZEPUnicodeString& iText);
  void SetLongHelp(const ZEPUnicodeString& iText);
  const ZEPUnicodeString& GetTitle() const;
  const ZEPUnicodeString& GetHelp() const;
  const ZEPUnicodeString& GetShortHelp() const;
  const ZEPUnicodeString& GetLongHelp() const;
  void SetIconName(const ZEPString& iNormal, const ZEPString& iSelected = "", const ZEPString& iFocused = "",
                   const ZEPString& iDisabled = "");

  ZEPDlgLock* GetLock() const { return _pLock; }

protected:
  // Run by each subclass constructor once the inner control exists.
  void Initialize();

  ZEPDialog* _pDialog = nullptr;
  ZEPDlgLock* _pLock = nullptr;
};
