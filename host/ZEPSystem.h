// Object model, check reporters, message catalogs and environment access.
#pragma once

#include "ZEPHostTypes.h"

#include <string>
#include <vector>

// ---- Object model -------------------------------------------------------------------------
class ZEPBaseUnknown;

// Factory entry of a class registered with the object model: a new instance, or null.
using ZEPCreateItselfFct = ZEPBaseUnknown* (*)();

// Run-time class description: a name and the description of the base class.
class ZEPMetaObject {
public:
  ZEPMetaObject(const char* iName, const ZEPMetaObject* iBase, const char* iExtendedType = "ZEPnull",
                const char* iFramework = "ZEPHost", ZEPCreateItselfFct iCreate = nullptr);
  const char* GetName() const { return _pName; }
  // The identifier the object model knows the class by: its registered name.
  const char* ClassId() const { return _pName; }
  // What the class's factory entry makes; null without one.
  ZEPBaseUnknown* CreateInstance() const { return _pCreate ? _pCreate() : nullptr; }
  const ZEPMetaObject* GetBase() const { return _pBase; }
  const char* GetExtendedType() const { return _pExtended; }
  const char* GetFramework() const { return _pFramework; }
  bool IsAKindOf(const ZEPMetaObject* iOther) const;
  bool IsAKindOf(const char* iName) const;

private:
  const char* _pName;
  const ZEPMetaObject* _pBase;
  const char* _pExtended;
  const char* _pFramework;
  ZEPCreateItselfFct _pCreate;
};

// The meta object registered under iName, created and registered by the first call (later
// calls answer that one, whatever they pass). Null for a null or empty name.
const ZEPMetaObject* fct_RetrieveMetaObject(const char* iName, const ZEPMetaObject* iBase, const char* iExtendedType,
                                            const char* iFramework, ZEPCreateItselfFct iCreate);
// A class registered through fct_RetrieveMetaObject; null when there is none of that name.
const ZEPMetaObject* ZEPFindMetaObject(const char* iName);

class ZEPBaseUnknown {
public:
  virtual ~ZEPBaseUnknown() = default;
  static const ZEPMetaObject* MetaObject();
  virtual const ZEPMetaObject* GetMetaObject() const { return MetaObject(); }
  virtual const char* IsA() const { return GetMetaObject()->GetName(); }
  virtual int IsAKindOf(const char* iClassName) const { return GetMetaObject()->IsAKindOf(iClassName) ? 1 : 0; }
};

// Declares the object-model members of a class; ZEP_IMPLEMENT_CLASS defines them.
#define ZEP_DECLARE_CLASS                                                                         \
public:                                                                                           \
  static const ZEPMetaObject* MetaObject();                                                      \
  const ZEPMetaObject* GetMetaObject() const override { return MetaObject(); }

#define ZEP_IMPLEMENT_CLASS_EX(Cls, Base, Ext, Fw)                                                \
  const ZEPMetaObject* Cls::MetaObject() {                                                       \
    static const ZEPMetaObject meta(#Cls, Base::MetaObject(), Ext, Fw);                          \
    return &meta;                                                                                 \
  }
#define ZEP_IMPLEMENT_CLASS(Cls, Base) ZEP_IMPLEMENT_CLASS_EX(Cls, Base, "ZEPnull", "ZEPHost")

// The object when it is of the class described by iMeta or derived from it, else null.
ZEPBaseUnknown* ZEPSysDynamicCast(const ZEPMetaObject* iMeta, ZEPBaseUnknown* iObject);

// Typed form: ZEPSysDynamicCast<ZEPDlgCombo>(widget).
template <class T> T* ZEPSysDynamicCast(ZEPBaseUnknown* iObject) {
  return dynamic_cast<T*>(ZEPSysDynamicCast(T::MetaObject(), iObject));
}

// ---- Check reporters ----------------------------------------------------------------------
struct ZEPCheckEntry {
  std::string reporter;   // "Check_Pointer_Failed__", ...
  std::string expression; // the check's own text
  std::string path;       // source path
  int line = 0;
};

// Every failed check reported by the module, in order. Printed to stderr as well
// when ZEP_CHECK_STDERR is set.
class ZEPCheckLog {
public:
  static const std::vector<ZEPCheckEntry>& Entries();
  static int Count();
  static bool Contains(const std::string& iExpression);
  static void Clear();
  static void Add(const char* iReporter, const char* iExpression, const char* iPath, int iLine);
};

void Check_Pointer_Failed__(const char* iExpression, const char* iPath, int iLine, const char* iExplanation);
void Check_TRUE_Failed__(const char* iExpression, const char* iPath, int iLine, const char* iExplanation);
void CheckFailure__(const char* iExpression, const char* iPath, int iLine, const char* iExplanation);
void Check_Handler_Failed__(const char* iExpression, const char* iPath, int iLine, const char* iExplanation);

// ---- Environment and message catalogs ----------------------------------------------------
// Non-null when the variable is set.
const char* ZEPGetEnv(const char* iName);

// Message catalogs are files "<catalog>.msg" in the catalogs folder of the resources
// (ZEP_RESOURCES overrides the built-in location). Lines: Key = "text"; '#' starts a comment.
class ZEPMsgCatalog {
public:
  static ZEPUnicodeString BuildMessage(const ZEPString& iCatalog, const ZEPString& iKey,
                                       const ZEPUnicodeString* iParams = nullptr, int iParamCount = 0,
                                       const ZEPUnicodeString& iDefault = ZEPUnicodeString(),
                                       void* iReserved = nullptr);
  // True and the text when the catalog holds the key.
  static bool Find(const ZEPString& iCatalog, const ZEPString& iKey, ZEPUnicodeString& oText);

  // A catalog as loaded, indexed once by widget name for the toolkit.
  struct Loaded;
  enum WidgetText { Title, Help, ShortHelp, LongHelp, WidgetTextCount };
  // The catalog, loaded at the first call (an empty one when there is no such file).
  static const Loaded& Get(const ZEPString& iCatalog);
  // The texts of a widget name in iCatalog (keys "<name>.Title", ".Help", ".ShortHelp",
  // ".LongHelp"), each null when the catalog does not hold it; null when it holds none.
  static const std::string* const* FindWidget(const Loaded& iCatalog, const std::string& iName);
  // Changes at each Reset: what was taken from Get before is gone then.
  static unsigned Generation();
  static std::string ResourceDir();
  // Forgets every loaded catalog (tests that change the resources folder).
  static void Reset();
};
