// The standards container: the standard files of a type.
#pragma once

#include "ZEPHostTypes.h"

#include <string>
#include <vector>

class ZEPStdServices {
public:
  // A new list of the file names of that type (the caller deletes it), or null when the
  // container has no list for the type.
  static ZEPListValZEPUnicodeString* GetStandardFiles(ZEPUnicodeString& iType);
};

// Configuration of the standards container, for the application and for tests.
// By default the files of a type are those of <standards folder>/<type>/, in name order;
// a type without such a folder has no list.
class ZEPStdSetup {
public:
  // Empty: the "standards" folder of the resources.
  static void SetStandardsFolder(const std::string& iFolder);
  static std::string GetStandardsFolder();
  // These names, as given, for that type instead of its folder.
  static void SetStandardFiles(const ZEPUnicodeString& iType,
                               const std::vector<ZEPUnicodeString>& iFiles);
  // The container answers no list for that type.
  static void SetNoList(const ZEPUnicodeString& iType);
  // The standards folder of the resources, no explicit lists.
  static void Reset();
};
