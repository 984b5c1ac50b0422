// Knowledge units: magnitude types, the units the user works with and drawing scales.
#pragma once

#include "ZEPHostTypes.h"

#include <cstddef>
#include <memory>

// Drawing scale ranges; each range has its own length unit.
enum ZEPCkeScale : int {
  ZEPCkeScaleNormal = 1,
  ZEPCkeScaleLarge = 2,
  ZEPCkeScaleExtraLarge = 3,
  ZEPCkeScaleSmall = 4,
  ZEPCkeScaleExtraSmall = 5
};

// Smart handle on a shared knowledge object; it may be null. A handle built from a handle
// of another interface is a cast: null when the object does not offer the interface.
template <class T> class ZEPCkeVar {
public:
  ZEPCkeVar() = default;
  ZEPCkeVar(std::nullptr_t) {}
  explicit ZEPCkeVar(std::shared_ptr<T> iObject) : _spObject(std::move(iObject)) {}
  template <class U>
  ZEPCkeVar(const ZEPCkeVar<U>& iOther)
      : _spObject(std::dynamic_pointer_cast<T>(iOther.Object())) {}

  T* operator->() const { return _spObject.get(); }
  bool operator!() const { return !_spObject; }
  explicit operator bool() const { return _spObject != nullptr; }
  const std::shared_ptr<T>& Object() const { return _spObject; }
  void Release() { _spObject.reset(); }

private:
  std::shared_ptr<T> _spObject;
};

// A knowledge type (length, angle, ...).
class ZEPICkeType {
public:
  virtual ~ZEPICkeType() = default;
};

class ZEPICkeUnit {
public:
  explicit ZEPICkeUnit(ZEPUnicodeString iName) : _name(std::move(iName)) {}
  virtual ~ZEPICkeUnit() = default;
  // The unit's name in the units table: "MM", "INCH", "DEGREE", ...
  ZEPUnicodeString GetUnitName() const { return _name; }

private:
  ZEPUnicodeString _name;
};
using ZEPICkeUnit_var = ZEPCkeVar<ZEPICkeUnit>;

// A type with units: a length or an angle.
class ZEPICkeMagnitude : public ZEPICkeType {
public:
  explicit ZEPICkeMagnitude(bool iIsLength) : _bIsLength(iIsLength) {}
  // The unit the user works with at that scale; a null handle when there is none.
  long GetScaleUnit(ZEPICkeUnit_var& oUnit, ZEPCkeScale iScale) const;

private:
  bool _bIsLength;
};

using ZEPICkeType_var = ZEPCkeVar<ZEPICkeType>;
using ZEPICkeMagnitude_var = ZEPCkeVar<ZEPICkeMagnitude>;

class ZEPCkeValueServices {
public:
  // Builds the types dictionary; the dictionary answers no type before it.
  static void ForceDictionaryInit();
};

class ZEPParmDictionary {
public:
  static ZEPICkeType_var LengthType();
  static ZEPICkeType_var AngleType();
};

// Configuration of the knowledge units, for the application and for tests.
class ZEPCkeUnitsSetup {
public:
  // Units the host knows: "METER", "micron", "MM", "CM", "KM", "INCH", "FOOT", "F_I_F64",
  // "F_I_F16", "F_I_DEC", "DM", "YARD", "MILE" for lengths; "RADIAN", "DEGREE", "GRADE",
  // "TURN" for angles. An empty name means no unit. Each answers false, changing nothing,
  // for a name the host does not know or a scale outside 1 to 5.
  static bool SetLengthUnit(const ZEPUnicodeString& iName); // every scale range
  static bool SetLengthUnit(ZEPCkeScale iScale, const ZEPUnicodeString& iName);
  static bool SetAngleUnit(const ZEPUnicodeString& iName);
  static ZEPUnicodeString GetLengthUnit(ZEPCkeScale iScale);
  static ZEPUnicodeString GetAngleUnit();
  // Unavailable magnitudes: the length and angle types are no magnitudes.
  static void SetMagnitudesAvailable(bool iAvailable);
  // Unavailable units: every GetScaleUnit answers a null handle.
  static void SetUnitsAvailable(bool iAvailable);
  // "MM" at every range, "DEGREE", everything available, dictionary not yet built.
  static void Reset();
};
