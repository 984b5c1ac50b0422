// Setting hooks of the options pages, generated from one table per page.
//
// Each page has a table "<Page>.def" listing its attributes in slot order:
//     ZEP_SETTING(DisplayGrid, Flag)
//     ZEP_SETTING(PrimSpaceH,  DoubleArray)
// Expanding the table with ZEP_DECLARE_SETTING_HOOKS declares, for each attribute, the
// setter SetSys<Name>, the getter GetSys<Name> and the info hook GetSys<Name>Info, in that
// order; ZEP_DEFINE_SETTING_HOOKS gives the module's own bodies (E_NOTIMPL, getters clear
// their output). The application and the tests expand the same table to bind or record.
//
// Kinds and their hook arguments:
//   Flag        unsigned char            Int       int             UInt   unsigned int
//   Double      double                   Text      ZEPUnicodeString
//   TextList    ZEPListValZEPUnicodeString (getter leaves the list untouched)
//   ColorInt    three int                ColorUInt three unsigned int
//   FlagArray, IntArray, DoubleArray: (pointer to the first value, int count)
#pragma once

#include "ZEPHost.h"

// Value types of the scalar kinds.
#define ZEP_TYPE_Flag unsigned char
#define ZEP_TYPE_Int int
#define ZEP_TYPE_UInt unsigned int
#define ZEP_TYPE_Double double
#define ZEP_TYPE_Text ZEPUnicodeString
#define ZEP_TYPE_TextList ZEPListValZEPUnicodeString
#define ZEP_TYPE_FlagArray unsigned char
#define ZEP_TYPE_IntArray int
#define ZEP_TYPE_DoubleArray double
#define ZEP_TYPE_ColorInt int
#define ZEP_TYPE_ColorUInt unsigned int

// Shape of each kind: Scalar, Array or Color.
#define ZEP_SHAPE_Flag Scalar
#define ZEP_SHAPE_Int Scalar
#define ZEP_SHAPE_UInt Scalar
#define ZEP_SHAPE_Double Scalar
#define ZEP_SHAPE_Text Scalar
#define ZEP_SHAPE_TextList Scalar
#define ZEP_SHAPE_FlagArray Array
#define ZEP_SHAPE_IntArray Array
#define ZEP_SHAPE_DoubleArray Array
#define ZEP_SHAPE_ColorInt Color
#define ZEP_SHAPE_ColorUInt Color

#define ZEP_CAT_(a, b) a##b
#define ZEP_CAT(a, b) ZEP_CAT_(a, b)

// Parameter lists by shape: setter (const), getter, and the argument names.
#define ZEP_SETPARAMS_Scalar(T) const T& iValue
#define ZEP_GETPARAMS_Scalar(T) T& oValue
#define ZEP_SETARGS_Scalar iValue
#define ZEP_GETARGS_Scalar oValue
#define ZEP_SETPARAMS_Array(T) const T* iValues, int iCount
#define ZEP_GETPARAMS_Array(T) T* oValues, int iCount
#define ZEP_SETARGS_Array iValues, iCount
#define ZEP_GETARGS_Array oValues, iCount
#define ZEP_SETPARAMS_Color(T) const T& iRed, const T& iGreen, const T& iBlue
#define ZEP_GETPARAMS_Color(T) T& oRed, T& oGreen, T& oBlue
#define ZEP_SETARGS_Color iRed, iGreen, iBlue
#define ZEP_GETARGS_Color oRed, oGreen, oBlue

#define ZEP_SETPARAMS(Kind) ZEP_CAT(ZEP_SETPARAMS_, ZEP_SHAPE_##Kind)(ZEP_TYPE_##Kind)
#define ZEP_GETPARAMS(Kind) ZEP_CAT(ZEP_GETPARAMS_, ZEP_SHAPE_##Kind)(ZEP_TYPE_##Kind)
#define ZEP_SETARGS(Kind) ZEP_CAT(ZEP_SETARGS_, ZEP_SHAPE_##Kind)
#define ZEP_GETARGS(Kind) ZEP_CAT(ZEP_GETARGS_, ZEP_SHAPE_##Kind)

#define ZEP_DECLARE_SETTING_HOOKS(Name, Kind)                                                       \
  virtual long SetSys##Name(ZEP_SETPARAMS(Kind));                                                  \
  virtual long GetSys##Name(ZEP_GETPARAMS(Kind));                                                  \
  virtual long GetSys##Name##Info(ZEPSettingInfo& oInfo);

#define ZEP_DEFINE_SETTING_HOOKS(Page, Name, Kind)                                                  \
  long Page::SetSys##Name(ZEP_SETPARAMS(Kind)) {                                                    \
    ZEPHookDefaults::Ignore(ZEP_SETARGS(Kind));                                                     \
    return E_NOTIMPL;                                                                               \
  }                                                                                                 \
  long Page::GetSys##Name(ZEP_GETPARAMS(Kind)) {                                                    \
    ZEPHookDefaults::Clear(ZEP_GETARGS(Kind));                                                      \
    return E_NOTIMPL;                                                                               \
  }                                                                                                 \
  long Page::GetSys##Name##Info(ZEPSettingInfo&) { return E_NOTIMPL; }

// What the module's own hook bodies do with their arguments.
struct ZEPHookDefaults {
  template <class... T> static void Ignore(const T&...) {}
  template <class T> static void Clear(T& oValue) { oValue = T(); }
  static void Clear(ZEPUnicodeString& oValue) { oValue = ZEPUnicodeString(); }
  // A list getter leaves the caller's list as it is.
  static void Clear(ZEPListValZEPUnicodeString&) {}
  template <class T> static void Clear(T* oValues, int iCount) {
    for (int i = 0; oValues && i < iCount; ++i) oValues[i] = T();
  }
  template <class T> static void Clear(T& oRed, T& oGreen, T& oBlue) { oRed = oGreen = oBlue = T(); }
};

// Slot indices of a page's attributes, for pages that go over rows of controls: inside the
// page class,
//     enum Slot {
//   #define ZEP_SETTING(Name, Kind) ZEP_SETTING_SLOT(Name)
//   #include "<Page>.def"
//   #undef ZEP_SETTING
//       kSlotCount };
#define ZEP_SETTING_SLOT(Name) kSlot##Name,

// The hooks of one attribute as member pointers, indexed by slot: the info hook of every
// attribute; setter and getter of flags only (null for the other kinds). A table of them is
// expanded with ZEP_SETTING_SLOT_HOOKS inside a member of the page (the hooks are protected).
template <class Page> struct ZEPSettingSlotHooks {
  long (Page::*info)(ZEPSettingInfo&);
  long (Page::*set)(const unsigned char&);
  long (Page::*get)(unsigned char&);
};

#define ZEP_IS_FLAG_Flag 1
#define ZEP_IS_FLAG_Int 0
#define ZEP_IS_FLAG_UInt 0
#define ZEP_IS_FLAG_Double 0
#define ZEP_IS_FLAG_Text 0
#define ZEP_IS_FLAG_TextList 0
#define ZEP_IS_FLAG_FlagArray 0
#define ZEP_IS_FLAG_IntArray 0
#define ZEP_IS_FLAG_DoubleArray 0
#define ZEP_IS_FLAG_ColorInt 0
#define ZEP_IS_FLAG_ColorUInt 0
#define ZEP_SLOT_HOOKS_1(Page, Name) {&Page::GetSys##Name##Info, &Page::SetSys##Name, &Page::GetSys##Name},
#define ZEP_SLOT_HOOKS_0(Page, Name) {&Page::GetSys##Name##Info, nullptr, nullptr},
#define ZEP_SETTING_SLOT_HOOKS(Page, Name, Kind) ZEP_CAT(ZEP_SLOT_HOOKS_, ZEP_IS_FLAG_##Kind)(Page, Name)
