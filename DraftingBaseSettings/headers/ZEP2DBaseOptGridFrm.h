// Options page of the drawing grid: display, snap, spacing and graduations per scale
// range, and distortion (vertical values differing from the horizontal ones).
#pragma once

#include "ZEPDrwSettingHooks.h"

class ZEPDrwLockCheckButton;
class ZEPDrwLockSpinner;
class ZEP2DBaseRangeCmb;

class ZEP2DBaseOptGridFrm : public ZEPDlgFrame {
public:
  ~ZEP2DBaseOptGridFrm() override;
  ZEPString GetResourceFilename(int iIndex = 0) const override;
  void Build();
  void Initialize();

  // Values kept per scale range.
  static constexpr int kRangeCount = 5;

protected:
  ZEP2DBaseOptGridFrm(ZEPDialog* iParent, const ZEPString& iName);

#define ZEP_SETTING(Name, Kind) ZEP_DECLARE_SETTING_HOOKS(Name, Kind)
#include "ZEP2DBaseOptGridFrm.def"
#undef ZEP_SETTING

private:
  void UpdateWidgets();
  void UpdateGridValues();
  void Write(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData);
  // Index of the current range in the per-range arrays.
  int Index() const { return _currentRange - 1; }

  ZEPDrwLockCheckButton* _pChkGrid = nullptr;
  ZEPDrwLockCheckButton* _pChkSnap = nullptr;
  ZEPDrwLockSpinner* _pSpnSpacingH = nullptr;
  ZEPDrwLockSpinner* _pSpnGraduationH = nullptr;
  ZEPDrwLockCheckButton* _pChkDistortions = nullptr;
  ZEPDrwLockSpinner* _pSpnSpacingV = nullptr;
  ZEPDrwLockSpinner* _pSpnGraduationV = nullptr;
  ZEP2DBaseRangeCmb* _pRangeCmb = nullptr;
  double _dPrimSpaceH[kRangeCount];
  double _dPrimSpaceV[kRangeCount];
  int _iGradH[kRangeCount];
  int _iGradV[kRangeCount];
  int _currentRange = 1;
  unsigned char _bDisplayGrid = 0;
  unsigned char _bSnapToPoint = 0;
  unsigned char _bAllowDistortions[kRangeCount];
};
