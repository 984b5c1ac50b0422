#include "ZEPSketcherSettings.h"

#include <algorithm>

ZEP_IMPLEMENT_CLASS(ZEPCallbackManager, ZEPBaseUnknown)
ZEP_IMPLEMENT_CLASS(ZEPSketcherSettings, ZEPCallbackManager)

ZEPCallbackManager::CallbackId ZEPCallbackManager::AddCallback(const char* iEventName,
                                                               Callback iCallback) {
  if (!iEventName || !iCallback) return 0;
  _subscriptions.push_back(Subscription{++_lastId, iEventName, std::move(iCallback)});
  return _lastId;
}

bool ZEPCallbackManager::RemoveCallback(CallbackId iId) {
  auto it = std::find_if(_subscriptions.begin(), _subscriptions.end(),
                         [iId](const Subscription& s) { return s.id == iId; });
  if (it == _subscriptions.end()) return false;
  _subscriptions.erase(it);
  return true;
}

void ZEPCallbackManager::DispatchCallbacks(const char* iEventName, ZEPNotification* iNotif,
                                           void* iData) {
  if (!iEventName) return;
  // Work on the ids known now: callbacks may change the subscriptions while we run, or
  // destroy this manager.
  const std::shared_ptr<bool> alive = _pAlive;
  std::vector<CallbackId> ids;
  for (const Subscription& s : _subscriptions)
    if (s.event == iEventName) ids.push_back(s.id);
  for (CallbackId id : ids) {
    if (!*alive) return;
    auto it = std::find_if(_subscriptions.begin(), _subscriptions.end(),
                           [id](const Subscription& s) { return s.id == id; });
    if (it == _subscriptions.end()) continue; // removed by an earlier callback
    Callback callback = it->callback;         // a copy survives its own removal
    callback(iEventName, iNotif, iData);
  }
}

const char* ZEPSketcherSettings::MultiModification() {
  return "ZEPSketcherSettings::MultiModification";
}
const char* ZEPSketcherSettings::GridModification() {
  return "ZEPSketcherSettings::GridModification";
}
const char* ZEPSketcherSettings::GeomUIModification() {
  return "ZEPSketcherSettings::GeomUIModification";
}
const char* ZEPSketcherSettings::SnapModification() {
  return "ZEPSketcherSettings::SnapModification";
}
const char* ZEPSketcherSettings::Visu3DUIModification() {
  return "ZEPSketcherSettings::Visu3DUIModification";
}
const char* ZEPSketcherSettings::CpltModification() {
  return "ZEPSketcherSettings::CpltModification";
}
