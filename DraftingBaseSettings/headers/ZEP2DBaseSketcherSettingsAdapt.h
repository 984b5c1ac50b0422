// The host sketcher's settings served from the drafting setting repositories.
#pragma once

#include "ZEPSettings.h"
#include "ZEPSketcherSettings.h"

// Every value lives in one of two repositories that the hosting subclass opens and assigns
// to _pSettRep (general: completion, creation, drag, smart pick and construction colours) and
// _pSpecificSettRep (grid, distortion and diagnosis settings); the adapter never opens or
// frees them. Getters read anew each time and fall back to fixed defaults; setters write at
// once and, when asked, send the setting's modification event with the adapter as data.
class ZEP2DBaseSketcherSettingsAdapt : public ZEPSketcherSettings {
public:
  // Attribute names in the repositories.
  static const char* const mstrGridDisplay;
  static const char* const mstrGridSnapPt;
  static const char* const mstrGridHPrSpacing;
  static const char* const mstrGridHSecStep;
  static const char* const mstrAllowDistortions;
  static const char* const mstrGridVPrSpacing;
  static const char* const mstrGridVSecStep;
  static const char* const mstrGeomCreateCenter;
  static const char* const mstrCpltPosSupport;
  static const char* const mstrCpltPosHorVertTo;
  static const char* const mstrCpltDirHorVert;
  static const char* const mstrCpltDirParPerpTan;
  static const char* const mstrCpltCreateConstraint;
  static const char* const mstrDragWithEndPts;
  static const char* const mstrDragMode;
  static const char* const mstrDragElts;
  static const char* const mstrDiagElts;
  static const char* const mstrColorDiagOverDefinedElts;
  static const char* const mstrColorDiagNotConsistentElts;
  static const char* const mstrColorDiagNotChangedElts;
  static const char* const mstrColorDiagWellDefinedElts;
  static const char* const mstrColorConstructElts;
  static const char* const mstrColorSmartPick;
  static const char* const mstrShowPosition;

  // Saves the general repository, then the specific one; E_FAIL at the first failure.
  long SaveRepository() override;

  int GetGridVisuMode() override;
  int GetGridGroundMode() override;
  int GetGridSnapMode() override;

  // Ranges 1 to 5; any other range reads the entry of range 1.
  double GetGridPrimSpac(ZEPCkeScale iRange) override;
  int GetGridSecStep(ZEPCkeScale iRange) override;
  int GetAllowDistortions(ZEPCkeScale iRange) override;
  double GetGridVPrimSpac(ZEPCkeScale iRange) override;
  int GetGridVSecStep(ZEPCkeScale iRange) override;

  int GetAnimate() override;
  int GetCreateCenter() override;
  int GetPosSupports() override;
  int GetPosHorVertTo() override;
  int GetDirHorVert() override;
  int GetDirParaPerpTan() override;
  int GetDirParallel() override;
  int GetDirPerpend() override;
  int GetDirTangent() override;

  // 0 whenever all four completion settings are off, whatever "CstCreation" holds.
  int GetCreateConstraint() override;
  int GetValidateConstraint() override;
  int GetValidateCstType(ZEP2DCstType iType) override;

  int GetDragWithEndPts() override;
  int GetDragMode() override;
  int GetDragElts() override;
  int GetDiagElts() override;

  void GetColorDiagElts(ZEP2DCstDiag iDiag, unsigned int* iRed, unsigned int* iGreen,
                        unsigned int* iBlue) override;
  void GetColorIsolatedElts(unsigned int* iRed, unsigned int* iGreen, unsigned int* iBlue) override;
  void GetColorProtectedElts(unsigned int* iRed, unsigned int* iGreen,
                             unsigned int* iBlue) override;
  void GetColorConstructElts(unsigned int* iRed, unsigned int* iGreen,
                             unsigned int* iBlue) override;
  void GetColorSmartPick(unsigned int* iRed, unsigned int* iGreen, unsigned int* iBlue) override;

  int GetShowPosition() override;
  int GetShowPositionOnCursor() override;

  void SetGridVisuMode(int iValue, int iNotify) override;
  void SetGridGroundMode(int iValue, int iNotify) override;
  void SetGridSnapMode(int iValue, int iNotify) override;
  // Write the value of iRange (range 1 for a range outside 1 to 5) and keep the other ranges.
  void SetGridPrimSpac(double iValue, int iNotify, ZEPCkeScale iRange) override;
  void SetGridSecStep(int iValue, int iNotify, ZEPCkeScale iRange) override;
  void SetAllowDistortions(int iValue, int iNotify, ZEPCkeScale iRange) override;
  void SetGridVPrimSpac(double iValue, int iNotify, ZEPCkeScale iRange) override;
  void SetGridVSecStep(int iValue, int iNotify, ZEPCkeScale iRange) override;
  void SetAnimate(int iValue, int iNotify) override;
  void SetCreateCenter(int iValue, int iNotify) override;
  void SetPosSupports(int iValue, int iNotify) override;
  void SetPosHorVertTo(int iValue, int iNotify) override;
  void SetDirHorVert(int iValue, int iNotify) override;
  void SetDirParaPerpTan(int iValue, int iNotify) override;
  void SetDirParallel(int iValue, int iNotify) override;
  void SetDirPerpend(int iValue, int iNotify) override;
  void SetDirTangent(int iValue, int iNotify) override;
  void SetCreateConstraint(int iValue, int iNotify) override;
  void SetValidateConstraint(int iValue, int iNotify) override;
  void SetDragWithEndPts(int iValue, int iNotify) override;
  void SetDragMode(int iValue, int iNotify) override;
  void SetDragElts(int iValue, int iNotify) override;
  void SetDiagElts(int iValue, int iNotify) override;
  void SetColorDiagElts(ZEP2DCstDiag iDiag, unsigned int iRed, unsigned int iGreen,
                        unsigned int iBlue, int iNotify) override;
  void SetColorIsolatedElts(unsigned int iRed, unsigned int iGreen, unsigned int iBlue,
                            int iNotify) override;
  void SetColorProtectedElts(unsigned int iRed, unsigned int iGreen, unsigned int iBlue,
                             int iNotify) override;
  void SetColorConstructElts(unsigned int iRed, unsigned int iGreen, unsigned int iBlue,
                             int iNotify) override;
  void SetColorSmartPick(unsigned int iRed, unsigned int iGreen, unsigned int iBlue,
                         int iNotify) override;
  void SetShowPosition(int iValue, int iNotify) override;
  void SetShowPositionOnCursor(int iValue, int iNotify) override;

  int GetViewNormalTo() override;
  void SetViewNormalTo(int iValue, int iNotify) override;

  // Send the interface's modification events, with the adapter as data.
  virtual void DispatchMultiModify();
  virtual void GridModify();
  virtual void GeomUIModify();
  virtual void SnapModify();
  virtual void Visu3DUIModify();
  virtual void CpltModify();

protected:
  ZEP2DBaseSketcherSettingsAdapt();
  // Forgets the repositories; they belong to the hosting subclass.
  ~ZEP2DBaseSketcherSettingsAdapt() override;

  // The colour of a diagnosis without a setting of its own, packed 0xRRGGBB.
  virtual unsigned int GetDefaultColorDiagElts(ZEP2DCstDiag iDiag) = 0;

  ZEPSysSettingRepository* _pSettRep = nullptr;
  ZEPSysSettingRepository* _pSpecificSettRep = nullptr;

private:
  // Packed 0xRRGGBB to components: written only when all three outputs are given.
  static void GetRGB(unsigned int iPacked, unsigned int* iRed, unsigned int* iGreen,
                     unsigned int* iBlue);
  // Components to packed 0xRRGGBB, when the output is given.
  static void SetRGB(unsigned int* iPacked, unsigned int iRed, unsigned int iGreen,
                     unsigned int iBlue);
};
