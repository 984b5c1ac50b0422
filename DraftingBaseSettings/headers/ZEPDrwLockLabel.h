// A caption that keeps the two-column layout of lock-aware controls: an invisible
// padlock-sized placeholder in column 0 and, when asked for, the text in column 1.
#pragma once

#include "ZEPHost.h"

class ZEPDrwLockLabel : public ZEPDlgFrame {
public:
  ZEPDrwLockLabel(ZEPDialog* iParent, const ZEPString& iName, int iWithText);
  ~ZEPDrwLockLabel() override;
  ZEPDrwLockLabel(const ZEPDrwLockLabel&) = delete;
  ZEPDrwLockLabel& operator=(const ZEPDrwLockLabel&) = delete;

  ZEPString GetName() const override;

  // To the text label only; nothing without one.
  void SetTitle(const ZEPUnicodeString& iText);
  void SetHelp(const ZEPUnicodeString& iText);
  void SetShortHelp(const ZEPUnicodeString& iText);
  void SetLongHelp(const ZEPUnicodeString& iText);
  void SetIconName(const ZEPString& iNormal, const ZEPString& iSelected = "", const ZEPString& iFocused = "",
                   const ZEPString& iDisabled = "");
  // From the text label when there is one, else the frame's own.
  const ZEPUnicodeString& GetTitle() const;
  const ZEPUnicodeString& GetHelp() const;
  const ZEPUnicodeString& GetShortHelp() const;
  const ZEPUnicodeString& GetLongHelp() const;

  ZEPDlgLabel* GetLabel() const { return _pLabel; }

private:
  ZEPDlgCheckButton* _pPlaceholder = nullptr;
  ZEPDlgLabel* _pLabel = nullptr;
};
