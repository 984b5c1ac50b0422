// PLM services: reference-counted interface objects, the knowledge type lookup, the PLM object
// chooser and its factory, component identification and unique keys.
#pragma once

#include "ZEPCkeUnits.h"
#include "ZEPDialog.h"

#include <memory>
#include <string>
#include <vector>

// An interface object of the PLM services: created with one reference, destroyed by its last
// Release. Interfaces are asked for with QueryInterface, each answer with its own reference.
class ZEPRefCounted : public ZEPBaseUnknown {
  ZEP_DECLARE_CLASS
public:
  ZEPRefCounted(const ZEPRefCounted&) = delete;
  ZEPRefCounted& operator=(const ZEPRefCounted&) = delete;

  unsigned long AddRef() { return ++_refs; }
  unsigned long Release();
  // S_OK and the interface, with a reference for the caller; E_FAIL and null when the object
  // does not offer it.
  template <class T> long QueryInterface(T*& oInterface) {
    oInterface = dynamic_cast<T*>(GetInterface(T::MetaObject()));
    return oInterface ? S_OK : E_FAIL;
  }

  // Objects alive now, of every reference-counted class: what tests count leaks with.
  static int LiveCount();

protected:
  ZEPRefCounted();
  ~ZEPRefCounted() override;
  // The object offering that interface with one more reference, or null. By default this
  // object when it is of that class.
  virtual ZEPRefCounted* GetInterface(const ZEPMetaObject* iInterface);

private:
  unsigned long _refs = 1;
};

// The host's list of interface pointers; each holds one reference for the list's owner.
using ZEPListPtrZEPBaseUnknown = ZEPList1<ZEPRefCounted*>;

// ---- knowledge types --------------------------------------------------------------------------
class ZEPIType : public ZEPICkeType {
public:
  explicit ZEPIType(ZEPUnicodeString iName) : _name(std::move(iName)) {}
  const ZEPUnicodeString& GetName() const { return _name; }

private:
  ZEPUnicodeString _name;
};
using ZEPIType_var = ZEPCkeVar<ZEPIType>;
using ZEPListValZEPIType_var = ZEPList1<ZEPIType_var>;

class ZEPCkeTypeProtectedServices {
public:
  // The knowledge type of that name ("DIFStandardRep" is the drafting standard); E_FAIL and a
  // null handle for a name the dictionary does not hold.
  static long RetrieveKnowledgeType(const ZEPUnicodeString& iName, ZEPIType_var& oType);
};

// ---- components and keys ----------------------------------------------------------------------
class ZEPPLMStandardObject;

// The identifier of a PLM component, from which its unique key is computed.
class ZEPPLMIdentificator : public ZEPRefCounted {
  ZEP_DECLARE_CLASS
public:
  explicit ZEPPLMIdentificator(ZEPPLMStandardObject* iObject);

private:
  ~ZEPPLMIdentificator() override;
  friend class ZEPAdpComponentQuery;
  ZEPPLMStandardObject* _pObject; // one reference
};

class ZEPIPLMComponent : public ZEPRefCounted {
  ZEP_DECLARE_CLASS
public:
  explicit ZEPIPLMComponent(ZEPPLMStandardObject* iObject);
  // S_OK and a new identificator the caller releases.
  long GetPLMID(ZEPPLMIdentificator*& oID);

protected:
  ZEPRefCounted* GetInterface(const ZEPMetaObject* iInterface) override;

private:
  ~ZEPIPLMComponent() override;
  ZEPPLMStandardObject* _pObject; // one reference
};

class ZEPIAlias : public ZEPRefCounted {
  ZEP_DECLARE_CLASS
public:
  explicit ZEPIAlias(ZEPUnicodeString iAlias) : _alias(std::move(iAlias)) {}
  // The display name of the component.
  ZEPUnicodeString GetAlias() const { return _alias; }

private:
  ZEPUnicodeString _alias;
};

class ZEPAdpUniqueKey {
public:
  ZEPAdpUniqueKey() = default;
  ZEPAdpUniqueKey(ZEPUnicodeString iKey, int iUnicity)
      : _key(std::move(iKey)), _unicity(iUnicity) {}
  // Negative when the key does not identify its component for sure.
  int UnicityGuarantee() const { return _unicity; }
  ZEPUnicodeString AsString() const { return _key; }

private:
  ZEPUnicodeString _key;
  int _unicity = -1;
};

class ZEPAdpComponentQuery {
public:
  // The error monitor is not used by the stand-in.
  explicit ZEPAdpComponentQuery(void* iErrorMonitor = nullptr) { (void)iErrorMonitor; }
  // S_OK and the key of the identified component; E_FAIL for a null identificator or when the
  // repository does not answer. oMessage, when given, receives the failure's text.
  long GetUniqueKey(ZEPPLMIdentificator* iID, ZEPAdpUniqueKey& oKey,
                    ZEPUnicodeString* oMessage = nullptr);
};

// ---- the chooser ------------------------------------------------------------------------------
class ZEPPLMNavigationOpenParameters {
public:
  void SetModeValue(unsigned int iMode) { _mode = iMode; }
  unsigned int GetModeValue() const { return _mode; }

private:
  unsigned int _mode = 0;
};

// A window in which the user picks PLM objects, then validates or cancels. Its command sends
// the two notifications; the objects chosen are asked for after the validation.
class ZEPIPLMChooser : public ZEPRefCounted {
  ZEP_DECLARE_CLASS
public:
  ZEPIPLMChooser(ZEPDialog* iParent, const ZEPString& iName, bool iWithCommand);

  long SetTypes(const ZEPListValZEPIType_var& iTypes);
  long SetNavigationOpenParameters(const ZEPPLMNavigationOpenParameters& iParameters, int iFlag);
  long SetModes(const ZEPRawCollint& iModes, int iFlag);
  // Null for a chooser that cannot be operated.
  ZEPCommand* GetCommand() const { return _pCommand.get(); }
  // Null without command.
  ZEPNotification* GetValidateNotification();
  ZEPNotification* GetCancelNotification();
  // S_OK and a new list of the objects chosen at the last validation (empty before one); the
  // caller releases each object and deletes the list.
  long GetChosenObjects(ZEPListPtrZEPBaseUnknown*& oList);
  void SetVisibility(unsigned long iVisibility) { _visibility = iVisibility; }
  unsigned long GetVisibility() const { return _visibility; }

  // What the chooser was given, for tests and the application.
  const ZEPDialog* GetParent() const { return _pParent; } // for comparison only
  const ZEPString& GetName() const { return _name; }
  const std::vector<std::string>& GetTypeNames() const { return _types; }
  unsigned int GetModeValue() const { return _mode; }
  int GetOpenFlag() const { return _openFlag; }
  const std::vector<int>& GetModes() const { return _modes; }
  int GetModesFlag() const { return _modesFlag; }

private:
  friend class ZEPPLMSetup;
  ~ZEPIPLMChooser() override;
  void SetChosen(std::vector<ZEPRefCounted*> iObjects);

  const ZEPDialog* _pParent;
  ZEPString _name;
  std::unique_ptr<ZEPCommand> _pCommand;
  std::vector<std::string> _types;
  unsigned int _mode = 0;
  int _openFlag = 0;
  std::vector<int> _modes;
  int _modesFlag = 0;
  unsigned long _visibility = ZEPDlgHide;
  std::vector<ZEPRefCounted*> _chosen; // one reference each
};

class ZEPIPLMChooserFactory : public ZEPRefCounted {
  ZEP_DECLARE_CLASS
public:
  // S_OK and a new chooser (hidden, one reference for the caller); E_FAIL and null when the
  // host cannot make one.
  long CreatePLMChooser(ZEPDialog* iParent, const ZEPString& iName, ZEPIPLMChooser*& oChooser);
};

class ZEPPLMUIBasicServices {
public:
  // S_OK and the factory (one reference for the caller); E_FAIL and null when PLM services
  // are not available.
  static long GetPLMChooserFactory(ZEPIPLMChooserFactory*& oFactory);
};

// ---- configuration and the user at the chooser ----------------------------------------------
// For the application and for tests. By default the factory exists and makes choosers with
// a command.
class ZEPPLMSetup {
public:
  // A standard object of the PLM repository, as the chooser lists it.
  struct Standard {
    std::string name;           // display name (alias)
    std::string key;            // unique key
    int unicity = 1;            // negative: the key is not guaranteed unique
    bool withComponent = true;  // offers the component interface
    bool withAlias = true;      // its component offers the alias interface
    bool keyQueryFails = false; // the repository does not answer for its key
  };

  static void SetFactoryAvailable(bool iAvailable);
  // The factory answers no chooser.
  static void SetChooserCreationFails(bool iFails);
  static void SetChooserWithCommand(bool iWithCommand);
  // Choosers made since the last reset.
  static int ChoosersCreated();
  // The chooser made last, while it lives (no reference is given); else null.
  static ZEPIPLMChooser* LiveChooser();

  // The user picks these objects in the shown chooser and validates, or cancels it. False,
  // nothing sent, when no chooser is shown or it has no command.
  static bool Validate(const std::vector<Standard>& iChosen);
  static bool Cancel();

  // The standards of the PLM repository, as the chooser lists them to the user (the
  // application reads them from its repository file). Empty by default.
  static void SetRepository(std::vector<Standard> iStandards);
  static const std::vector<Standard>& Repository();
  // What a chooser offers the user: the repository's standards once it was asked for the
  // drafting standard type ("DIFStandardRep"), else nothing.
  static std::vector<Standard> Listed(const ZEPIPLMChooser* iChooser);

  // The defaults; objects alive are left to their holders.
  static void Reset();
};

// The object behind a chosen standard: offers the component interface when configured so.
class ZEPPLMStandardObject : public ZEPRefCounted {
  ZEP_DECLARE_CLASS
public:
  explicit ZEPPLMStandardObject(ZEPPLMSetup::Standard iData) : _data(std::move(iData)) {}
  const ZEPPLMSetup::Standard& Data() const { return _data; }

protected:
  ZEPRefCounted* GetInterface(const ZEPMetaObject* iInterface) override;

private:
  ZEPPLMSetup::Standard _data;
};
