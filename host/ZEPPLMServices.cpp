#include "ZEPPLMServices.h"

#include <algorithm>

ZEP_IMPLEMENT_CLASS(ZEPRefCounted, ZEPBaseUnknown)
ZEP_IMPLEMENT_CLASS(ZEPPLMIdentificator, ZEPRefCounted)
ZEP_IMPLEMENT_CLASS(ZEPIPLMComponent, ZEPRefCounted)
ZEP_IMPLEMENT_CLASS(ZEPIAlias, ZEPRefCounted)
ZEP_IMPLEMENT_CLASS(ZEPIPLMChooser, ZEPRefCounted)
ZEP_IMPLEMENT_CLASS(ZEPIPLMChooserFactory, ZEPRefCounted)
ZEP_IMPLEMENT_CLASS(ZEPPLMStandardObject, ZEPRefCounted)

namespace {
int& Live() {
  static int live = 0;
  return live;
}

struct PLMState {
  bool factory = true;
  bool creationFails = false;
  bool withCommand = true;
  int created = 0;
  std::vector<ZEPIPLMChooser*> choosers; // alive, in creation order
  std::vector<ZEPPLMSetup::Standard> repository;
};
PLMState& State() {
  static PLMState state;
  return state;
}
} // namespace

// ---- reference counting -------------------------------------------------------------------------
ZEPRefCounted::ZEPRefCounted() { ++Live(); }
ZEPRefCounted::~ZEPRefCounted() { --Live(); }

unsigned long ZEPRefCounted::Release() {
  if (--_refs > 0) return _refs;
  delete this;
  return 0;
}

int ZEPRefCounted::LiveCount() { return Live(); }

ZEPRefCounted* ZEPRefCounted::GetInterface(const ZEPMetaObject* iInterface) {
  if (!iInterface || !GetMetaObject()->IsAKindOf(iInterface)) return nullptr;
  AddRef();
  return this;
}

// ---- knowledge types ----------------------------------------------------------------------------
long ZEPCkeTypeProtectedServices::RetrieveKnowledgeType(const ZEPUnicodeString& iName,
                                                        ZEPIType_var& oType) {
  if (iName != ZEPUnicodeString("DIFStandardRep")) {
    oType = ZEPIType_var();
    return E_FAIL;
  }
  oType = ZEPIType_var(std::make_shared<ZEPIType>(iName));
  return S_OK;
}

// ---- components and keys ------------------------------------------------------------------------
ZEPRefCounted* ZEPPLMStandardObject::GetInterface(const ZEPMetaObject* iInterface) {
  if (iInterface == ZEPIPLMComponent::MetaObject())
    return _data.withComponent ? new ZEPIPLMComponent(this) : nullptr;
  return ZEPRefCounted::GetInterface(iInterface);
}

ZEPIPLMComponent::ZEPIPLMComponent(ZEPPLMStandardObject* iObject) : _pObject(iObject) {
  _pObject->AddRef();
}
ZEPIPLMComponent::~ZEPIPLMComponent() { _pObject->Release(); }

ZEPRefCounted* ZEPIPLMComponent::GetInterface(const ZEPMetaObject* iInterface) {
  if (iInterface == ZEPIAlias::MetaObject())
    return _pObject->Data().withAlias ? new ZEPIAlias(ZEPUnicodeString(_pObject->Data().name))
                                      : nullptr;
  return ZEPRefCounted::GetInterface(iInterface);
}

long ZEPIPLMComponent::GetPLMID(ZEPPLMIdentificator*& oID) {
  oID = new ZEPPLMIdentificator(_pObject);
  return S_OK;
}

ZEPPLMIdentificator::ZEPPLMIdentificator(ZEPPLMStandardObject* iObject) : _pObject(iObject) {
  _pObject->AddRef();
}
ZEPPLMIdentificator::~ZEPPLMIdentificator() { _pObject->Release(); }

long ZEPAdpComponentQuery::GetUniqueKey(ZEPPLMIdentificator* iID, ZEPAdpUniqueKey& oKey,
                                        ZEPUnicodeString* oMessage) {
  if (!iID || iID->_pObject->Data().keyQueryFails) {
    if (oMessage) *oMessage = "The repository did not answer for the component's key.";
    return E_FAIL;
  }
  const ZEPPLMSetup::Standard& data = iID->_pObject->Data();
  oKey = ZEPAdpUniqueKey(ZEPUnicodeString(data.key), data.unicity);
  return S_OK;
}

// ---- the chooser --------------------------------------------------------------------------------
ZEPIPLMChooser::ZEPIPLMChooser(ZEPDialog* iParent, const ZEPString& iName, bool iWithCommand)
    : _pParent(iParent), _name(iName) {
  if (iWithCommand) _pCommand = std::make_unique<ZEPCommand>();
  State().choosers.push_back(this);
}

ZEPIPLMChooser::~ZEPIPLMChooser() {
  SetChosen({});
  auto& list = State().choosers;
  list.erase(std::remove(list.begin(), list.end(), this), list.end());
}

long ZEPIPLMChooser::SetTypes(const ZEPListValZEPIType_var& iTypes) {
  _types.clear();
  for (const ZEPIType_var& t : iTypes.Items())
    _types.push_back(t ? t->GetName().str() : std::string());
  return S_OK;
}

long ZEPIPLMChooser::SetNavigationOpenParameters(const ZEPPLMNavigationOpenParameters& iParameters,
                                                 int iFlag) {
  _mode = iParameters.GetModeValue();
  _openFlag = iFlag;
  return S_OK;
}

long ZEPIPLMChooser::SetModes(const ZEPRawCollint& iModes, int iFlag) {
  _modes = iModes.Items();
  _modesFlag = iFlag;
  return S_OK;
}

ZEPNotification* ZEPIPLMChooser::GetValidateNotification() {
  return _pCommand ? _pCommand->OwnNotification("PLMChooserValidate") : nullptr;
}

ZEPNotification* ZEPIPLMChooser::GetCancelNotification() {
  return _pCommand ? _pCommand->OwnNotification("PLMChooserCancel") : nullptr;
}

long ZEPIPLMChooser::GetChosenObjects(ZEPListPtrZEPBaseUnknown*& oList) {
  oList = new ZEPListPtrZEPBaseUnknown;
  for (ZEPRefCounted* o : _chosen) {
    o->AddRef();
    oList->Append(o);
  }
  return S_OK;
}

void ZEPIPLMChooser::SetChosen(std::vector<ZEPRefCounted*> iObjects) {
  for (ZEPRefCounted* o : _chosen)
    o->Release();
  _chosen = std::move(iObjects);
}

long ZEPIPLMChooserFactory::CreatePLMChooser(ZEPDialog* iParent, const ZEPString& iName,
                                             ZEPIPLMChooser*& oChooser) {
  oChooser = nullptr;
  if (State().creationFails) return E_FAIL;
  oChooser = new ZEPIPLMChooser(iParent, iName, State().withCommand);
  ++State().created;
  return S_OK;
}

long ZEPPLMUIBasicServices::GetPLMChooserFactory(ZEPIPLMChooserFactory*& oFactory) {
  oFactory = State().factory ? new ZEPIPLMChooserFactory : nullptr;
  return oFactory ? S_OK : E_FAIL;
}

// ---- configuration ------------------------------------------------------------------------------
void ZEPPLMSetup::SetFactoryAvailable(bool iAvailable) { State().factory = iAvailable; }
void ZEPPLMSetup::SetChooserCreationFails(bool iFails) { State().creationFails = iFails; }
void ZEPPLMSetup::SetChooserWithCommand(bool iWithCommand) { State().withCommand = iWithCommand; }
int ZEPPLMSetup::ChoosersCreated() { return State().created; }

ZEPIPLMChooser* ZEPPLMSetup::LiveChooser() {
  return State().choosers.empty() ? nullptr : State().choosers.back();
}

bool ZEPPLMSetup::Validate(const std::vector<Standard>& iChosen) {
  ZEPIPLMChooser* chooser = LiveChooser();
  if (!chooser || !chooser->GetCommand() || chooser->GetVisibility() != ZEPDlgShow) return false;
  std::vector<ZEPRefCounted*> objects;
  for (const Standard& s : iChosen)
    objects.push_back(new ZEPPLMStandardObject(s));
  chooser->SetChosen(std::move(objects));
  // The chooser may be released by a callback: the toolkit sends safely from a command that
  // dies on the way.
  chooser->GetCommand()->SendNotification(chooser->GetValidateNotification());
  return true;
}

bool ZEPPLMSetup::Cancel() {
  ZEPIPLMChooser* chooser = LiveChooser();
  if (!chooser || !chooser->GetCommand() || chooser->GetVisibility() != ZEPDlgShow) return false;
  chooser->GetCommand()->SendNotification(chooser->GetCancelNotification());
  return true;
}

void ZEPPLMSetup::SetRepository(std::vector<Standard> iStandards) {
  State().repository = std::move(iStandards);
}

const std::vector<ZEPPLMSetup::Standard>& ZEPPLMSetup::Repository() { return State().repository; }

std::vector<ZEPPLMSetup::Standard> ZEPPLMSetup::Listed(const ZEPIPLMChooser* iChooser) {
  if (!iChooser) return {};
  const std::vector<std::string>& types = iChooser->GetTypeNames();
  if (std::find(types.begin(), types.end(), "DIFStandardRep") == types.end()) return {};
  return State().repository;
}

void ZEPPLMSetup::Reset() {
  State().repository.clear();
  State().factory = true;
  State().creationFails = false;
  State().withCommand = true;
  State().created = 0;
}
