// Basic host types: statuses, strings and the host's 1-based lists.
#pragma once

#include <cstddef>
#include <string>
#include <vector>

#define S_OK 0L
// 32-bit result codes: failures are negative whatever the width of long.
#define E_FAIL static_cast<long>(static_cast<int>(0x80004005u))
#define E_NOTIMPL static_cast<long>(static_cast<int>(0x80004001u))
#define SUCCEEDED(hr) ((long)(hr) >= 0)
#define FAILED(hr) ((long)(hr) < 0)

// Widget names and icon names.
using ZEPString = std::string;

// Offset of the first byte of iText that does not belong to well-formed UTF-8 (no overlong
// forms, surrogates or code points above U+10FFFF), or std::string::npos when all of it does.
std::size_t ZEPFirstBadUtf8(const std::string& iText);

// User-visible text, stored as UTF-8. Character counts are code points.
class ZEPUnicodeString {
public:
  ZEPUnicodeString() = default;
  ZEPUnicodeString(const char* iText) : _sText(iText ? iText : "") {}
  ZEPUnicodeString(std::string iText) : _sText(std::move(iText)) {}

  const std::string& str() const { return _sText; }
  bool IsEmpty() const { return _sText.empty(); }

  // Number of characters (code points; a stray byte counts as one).
  int GetLengthInChar() const;
  // iStart and iLength in characters, 0-based; clipped to the text.
  ZEPUnicodeString SubString(int iStart, int iLength) const;
  // ASCII lower case; other characters unchanged.
  ZEPUnicodeString ToLower() const;
  // Removes the last iCount characters.
  void RemoveTail(int iCount);

  bool operator==(const ZEPUnicodeString& o) const { return _sText == o._sText; }
  bool operator!=(const ZEPUnicodeString& o) const { return _sText != o._sText; }
  // Collation of the host string type: byte-wise on UTF-8, i.e. by code point.
  bool operator>(const ZEPUnicodeString& o) const { return _sText > o._sText; }
  bool operator<(const ZEPUnicodeString& o) const { return _sText < o._sText; }
  ZEPUnicodeString operator+(const ZEPUnicodeString& o) const { return _sText + o._sText; }

private:
  std::string _sText;
};

// Host lists count from 1. Out-of-range positions are ignored by the mutators and
// give a default value from the accessors.
template <class T> class ZEPList1 {
public:
  using Comparator = int (*)(T*, T*);

  int Size() const { return static_cast<int>(_items.size()); }
  void Append(const T& iValue) { _items.push_back(iValue); }
  // Position (from 1) of the first value equal to iValue at or after iFrom; 0 if none.
  int Locate(const T& iValue, int iFrom = 1) const {
    for (int i = iFrom < 1 ? 1 : iFrom; i <= Size(); ++i)
      if (_items[static_cast<size_t>(i - 1)] == iValue) return i;
    return 0;
  }
  void RemovePosition(int iPos) {
    if (iPos >= 1 && iPos <= Size()) _items.erase(_items.begin() + (iPos - 1));
  }
  // The memory-handling mode of the host list is accepted for compatibility.
  void RemoveAll(int /*iMode*/ = 1) { _items.clear(); }
  void RemoveDuplicates() {
    std::vector<T> kept;
    for (const T& v : _items) {
      bool seen = false;
      for (const T& k : kept)
        if (k == v) { seen = true; break; }
      if (!seen) kept.push_back(v);
    }
    _items.swap(kept);
  }
  // Ascending by iCompare (>0: first is greater). The comparator need not be a
  // consistent ordering (it may never answer 0); the sort stays in bounds.
  void QuickSort(Comparator iCompare) {
    if (iCompare && Size() > 1) Sort(0, Size() - 1, iCompare);
  }

  const T& operator[](int iPos) const { return At(iPos); }
  const T& At(int iPos) const {
    static const T none{};
    return (iPos >= 1 && iPos <= Size()) ? _items[static_cast<size_t>(iPos - 1)] : none;
  }
  const std::vector<T>& Items() const { return _items; }

private:
  // Lomuto partition: the scan index never leaves [lo, hi], whatever the comparator says.
  void Sort(int lo, int hi, Comparator iCompare) {
    while (lo < hi) {
      int mid = lo + (hi - lo) / 2;
      std::swap(_items[static_cast<size_t>(mid)], _items[static_cast<size_t>(hi)]);
      T pivot = _items[static_cast<size_t>(hi)];
      int store = lo;
      for (int i = lo; i < hi; ++i) {
        if (iCompare(&_items[static_cast<size_t>(i)], &pivot) < 0) {
          std::swap(_items[static_cast<size_t>(i)], _items[static_cast<size_t>(store)]);
          ++store;
        }
      }
      std::swap(_items[static_cast<size_t>(store)], _items[static_cast<size_t>(hi)]);
      // Recurse into the smaller side to bound the stack depth.
      if (store - lo < hi - store) {
        Sort(lo, store - 1, iCompare);
        lo = store + 1;
      } else {
        Sort(store + 1, hi, iCompare);
        hi = store - 1;
      }
    }
  }

  std::vector<T> _items;
};

using ZEPListValZEPUnicodeString = ZEPList1<ZEPUnicodeString>;
using ZEPRawCollint = ZEPList1<int>;
