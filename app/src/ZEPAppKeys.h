// How the command line names a setting: "PAGE CONTROL", the dotted "PAGE.CONTROL", or the
// stored attribute ("DrwPaperLengthUnit"), whichever the user has; and the closest valid names
// when a name is unknown.
#pragma once

#include "ZEPAppPages.h"

#include <string>
#include <vector>

namespace zepapp {

struct ZEPAppKey {
  const ZEPAppPage* page = nullptr;
  std::string control;                    // as typed for a page form, else the table's name
  const ZEPAppSetting* setting = nullptr; // the stored attribute when the key named one
};

// Resolves the key at the start of iArgs: two arguments when the first is a page name, else one.
// oUsed tells how many it took. False with oError naming what is unknown and the closest names.
bool ResolveKey(const std::vector<std::string>& iArgs, ZEPAppKey& oKey, std::size_t& oUsed, std::string& oError);

// The row of the settings table behind a control of a page (its own or an embedded page's); null
// for a control that stores nothing.
const ZEPAppSetting* SettingOf(const ZEPAppPage& iPage, const std::string& iControl);
// The page that shows a stored attribute first (its own page rather than one embedding it).
const ZEPAppPage* PageOf(const ZEPAppSetting& iSetting);

// Up to iMax of iCandidates closest to iName (ignoring case), closest first; none when nothing is
// near enough to be a likely slip.
std::vector<std::string> Closest(const std::string& iName, const std::vector<std::string>& iCandidates,
                                 std::size_t iMax = 3);
// " Did you mean A, B or C?" or "".
std::string DidYouMean(const std::string& iName, const std::vector<std::string>& iCandidates);

} // namespace zepapp
