// The sketcher's settings interface and the callback manager it notifies through.
#pragma once

#include "ZEPCkeUnits.h"
#include "ZEPSystem.h"

#include <functional>
#include <memory>
#include <string>
#include <vector>

class ZEPNotification;

// Constraint types of the 2D sketcher. The underlying type is fixed so that any int the
// sketcher hands over (including unknown types) is a valid value.
enum ZEP2DCstType : int {
  ZEP2DCstNone = 0,
  ZEP2DCstDistance = 1,
  ZEP2DCstLength = 2,
  ZEP2DCstFix = 3,
  ZEP2DCstRadius = 4,
  ZEP2DCstCoincidence = 5,
  ZEP2DCstConcentricity = 6,
  ZEP2DCstTangency = 7,
  ZEP2DCstParallelism = 8,
  ZEP2DCstPerpendicularity = 9,
  ZEP2DCstAngle = 10,
  ZEP2DCstSymmetry = 11
};

// Diagnosis of a sketched element; other values may reach the settings as well.
enum ZEP2DCstDiag : int {
  ZEP2DCstOverDefined = 1,
  ZEP2DCstNotConsistent = 2,
  ZEP2DCstNotChanged = 3,
  ZEP2DCstWellDefined = 4
};

// Dispatches named events to the callbacks subscribed to them, synchronously and in
// subscription order.
class ZEPCallbackManager : public ZEPBaseUnknown {
  ZEP_DECLARE_CLASS
public:
  using Callback =
      std::function<void(const char* iEventName, ZEPNotification* iNotif, void* iData)>;
  using CallbackId = unsigned long;

  ZEPCallbackManager() = default;
  ~ZEPCallbackManager() override { *_pAlive = false; }
  ZEPCallbackManager(const ZEPCallbackManager&) = delete;
  ZEPCallbackManager& operator=(const ZEPCallbackManager&) = delete;

  // Subscribes iCallback to iEventName; the id unsubscribes it. 0 when nothing was subscribed.
  CallbackId AddCallback(const char* iEventName, Callback iCallback);
  // True when the subscription existed.
  bool RemoveCallback(CallbackId iId);
  int GetCallbackCount() const { return static_cast<int>(_subscriptions.size()); }

  // Calls every callback subscribed to iEventName. A callback may subscribe or unsubscribe
  // during the dispatch; those changes apply from the next dispatch on, except that a callback
  // removed during the dispatch is no longer called. A callback may also destroy the manager
  // itself (its subscriber going away with it): the dispatch then stops.
  void DispatchCallbacks(const char* iEventName, ZEPNotification* iNotif, void* iData);

private:
  struct Subscription {
    CallbackId id;
    std::string event;
    Callback callback;
  };
  std::vector<Subscription> _subscriptions;
  CallbackId _lastId = 0;
  // Shared with running dispatches, which must not touch a destroyed manager.
  std::shared_ptr<bool> _pAlive = std::make_shared<bool>(true);
};

// What the sketcher asks of its settings. Getters answer the current value; setters take
// the value and a notify flag: when it is non-zero the implementation sends the modification
// event of that setting after storing it.
class ZEPSketcherSettings : public ZEPCallbackManager {
  ZEP_DECLARE_CLASS
public:
  // Event names the sketcher subscribes to.
  static const char* MultiModification();
  static const char* GridModification();
  static const char* GeomUIModification();
  static const char* SnapModification();
  static const char* Visu3DUIModification();
  static const char* CpltModification();

  virtual long SaveRepository() = 0;

  virtual int GetGridVisuMode() = 0;
  virtual int GetGridGroundMode() = 0;
  virtual int GetGridSnapMode() = 0;
  // The sketcher's own grid does not adapt to the zoom unless an implementation says so.
  virtual int GetGridAdaptativeMode() { return 0; }

  virtual double GetGridPrimSpac(ZEPCkeScale iRange) = 0;
  virtual int GetGridSecStep(ZEPCkeScale iRange) = 0;
  virtual int GetAllowDistortions(ZEPCkeScale iRange) = 0;
  virtual double GetGridVPrimSpac(ZEPCkeScale iRange) = 0;
  virtual int GetGridVSecStep(ZEPCkeScale iRange) = 0;

  virtual int GetAnimate() = 0;
  virtual int GetCreateCenter() = 0;
  virtual int GetPosSupports() = 0;
  virtual int GetPosHorVertTo() = 0;
  virtual int GetDirHorVert() = 0;
  virtual int GetDirParaPerpTan() = 0;
  virtual int GetDirParallel() = 0;
  virtual int GetDirPerpend() = 0;
  virtual int GetDirTangent() = 0;

  virtual int GetCreateConstraint() = 0;
  virtual int GetValidateConstraint() = 0;
  virtual int GetValidateCstType(ZEP2DCstType iType) = 0;

  virtual int GetDragWithEndPts() = 0;
  virtual int GetDragMode() = 0;
  virtual int GetDragElts() = 0;
  virtual int GetDiagElts() = 0;

  virtual void GetColorDiagElts(ZEP2DCstDiag iDiag, unsigned int* iRed, unsigned int* iGreen,
                                unsigned int* iBlue) = 0;
  virtual void GetColorIsolatedElts(unsigned int* iRed, unsigned int* iGreen,
                                    unsigned int* iBlue) = 0;
  virtual void GetColorProtectedElts(unsigned int* iRed, unsigned int* iGreen,
                                     unsigned int* iBlue) = 0;
  virtual void GetColorConstructElts(unsigned int* iRed, unsigned int* iGreen,
                                     unsigned int* iBlue) = 0;
  virtual void GetColorSmartPick(unsigned int* iRed, unsigned int* iGreen, unsigned int* iBlue) = 0;

  virtual int GetShowPosition() = 0;
  virtual int GetShowPositionOnCursor() = 0;

  virtual void SetGridVisuMode(int iValue, int iNotify) = 0;
  virtual void SetGridGroundMode(int iValue, int iNotify) = 0;
  virtual void SetGridSnapMode(int iValue, int iNotify) = 0;
  virtual void SetGridPrimSpac(double iValue, int iNotify, ZEPCkeScale iRange) = 0;
  virtual void SetGridSecStep(int iValue, int iNotify, ZEPCkeScale iRange) = 0;
  virtual void SetAllowDistortions(int iValue, int iNotify, ZEPCkeScale iRange) = 0;
  virtual void SetGridVPrimSpac(double iValue, int iNotify, ZEPCkeScale iRange) = 0;
  virtual void SetGridVSecStep(int iValue, int iNotify, ZEPCkeScale iRange) = 0;
  virtual void SetAnimate(int iValue, int iNotify) = 0;
  virtual void SetCreateCenter(int iValue, int iNotify) = 0;
  virtual void SetPosSupports(int iValue, int iNotify) = 0;
  virtual void SetPosHorVertTo(int iValue, int iNotify) = 0;
  virtual void SetDirHorVert(int iValue, int iNotify) = 0;
  virtual void SetDirParaPerpTan(int iValue, int iNotify) = 0;
  virtual void SetDirParallel(int iValue, int iNotify) = 0;
  virtual void SetDirPerpend(int iValue, int iNotify) = 0;
  virtual void SetDirTangent(int iValue, int iNotify) = 0;
  virtual void SetCreateConstraint(int iValue, int iNotify) = 0;
  virtual void SetValidateConstraint(int iValue, int iNotify) = 0;
  virtual void SetDragWithEndPts(int iValue, int iNotify) = 0;
  virtual void SetDragMode(int iValue, int iNotify) = 0;
  virtual void SetDragElts(int iValue, int iNotify) = 0;
  virtual void SetDiagElts(int iValue, int iNotify) = 0;
  virtual void SetColorDiagElts(ZEP2DCstDiag iDiag, unsigned int iRed, unsigned int iGreen,
                                unsigned int iBlue, int iNotify) = 0;
  virtual void SetColorIsolatedElts(unsigned int iRed, unsigned int iGreen, unsigned int iBlue,
                                    int iNotify) = 0;
  virtual void SetColorProtectedElts(unsigned int iRed, unsigned int iGreen, unsigned int iBlue,
                                     int iNotify) = 0;
  virtual void SetColorConstructElts(unsigned int iRed, unsigned int iGreen, unsigned int iBlue,
                                     int iNotify) = 0;
  virtual void SetColorSmartPick(unsigned int iRed, unsigned int iGreen, unsigned int iBlue,
                                 int iNotify) = 0;
  virtual void SetShowPosition(int iValue, int iNotify) = 0;
  virtual void SetShowPositionOnCursor(int iValue, int iNotify) = 0;

  virtual int GetViewNormalTo() = 0;
  virtual void SetViewNormalTo(int iValue, int iNotify) = 0;
};
