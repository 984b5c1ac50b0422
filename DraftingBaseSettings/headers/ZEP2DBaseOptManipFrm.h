// Options page of the drafting manipulators: how they are shown (transparency, reference
// size, zoom), the paper grid, rotation snapping, leader direction snapping, and two matrices
// of check buttons saying which manipulators a dimension and an annotation offer.
#pragma once

#include "ZEPDrwSettingHooks.h"

class ZEPDrwLockCheckButton;
class ZEPDrwLockSpinner;

class ZEP2DBaseOptManipFrm : public ZEPDlgFrame {
public:
  ~ZEP2DBaseOptManipFrm() override;
  ZEPString GetResourceFilename(int iIndex = 0) const override;
  // iWithDimensions 0 leaves out the dimension matrix and the movable datum row.
  void Build(unsigned char iWithDimensions);
  void Initialize();

  // One row of a manipulator matrix, in screen order: the row name that the widget names are
  // made of, its icon, and the slots of its two attributes (first and second check column).
  struct MatrixRow {
    const char* name;
    const char* icon;
    int creSlot, modSlot;
  };
  // The dimension rows, then the annotation rows; kDimensionRows of them are dimension rows.
  static const MatrixRow* MatrixRows(int& oCount);
  static constexpr int kDimensionRows = 9;

protected:
  ZEP2DBaseOptManipFrm(ZEPDialog* iParent, const ZEPString& iName);

  // Whether the dimension matrix is shown (when Build is asked for dimensions).
  virtual unsigned char WithDimManipSection();

#define ZEP_SETTING(Name, Kind) ZEP_DECLARE_SETTING_HOOKS(Name, Kind)
#include "ZEP2DBaseOptManipFrm.def"
#undef ZEP_SETTING

public:
  enum Slot {
#define ZEP_SETTING(Name, Kind) ZEP_SETTING_SLOT(Name)
#include "ZEP2DBaseOptManipFrm.def"
#undef ZEP_SETTING
    kSlotCount
  };

private:
  static const ZEPSettingSlotHooks<ZEP2DBaseOptManipFrm>& Hooks(int iSlot);
  ZEPDrwLockCheckButton* Check(ZEPDialog* iFrame, int iSlot, const ZEPString& iName, short iRow,
                               short iColumn, short iWidth, unsigned int iFlags,
                               ZEPSettingInfo& ioInfo);
  ZEPDrwLockSpinner* Spinner(ZEPDialog* iFrame, const char* iName, short iRow,
                             const ZEPSettingInfo& iInfo);
  void BuildMatrix(ZEPDialog* iFrame, bool iDimensions, bool iWithDatum, ZEPSettingInfo& ioInfo);
  void UpdateWidgets();
  void Write(ZEPCommand* iSender, ZEPNotification* iNotif, void* iData);

  ZEPDrwLockSpinner* _pSpnRefSize = nullptr;
  ZEPDrwLockSpinner* _pSpnTransparency = nullptr;
  ZEPDrwLockSpinner* _pSpnGridSpacing = nullptr;
  ZEPDrwLockSpinner* _pSpnRotSnapAngle = nullptr;
  // The check button of each flag attribute (null for other kinds and rows not built).
  ZEPDrwLockCheckButton* _pChk[kSlotCount] = {};

  // Cached values; a flag's value sits at its slot.
  double _dRefSize = 0.0;
  double _dRotSnapAngle = 0.0;
  double _dGridSpacing = 0.0;
  int _iTransparency = 0;
  unsigned char _bFlag[kSlotCount] = {};
};
