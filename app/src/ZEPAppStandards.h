// Where the main page's drafting standards come from: the folder standards of a standards
// folder, and the PLM repository whose standards the PLM object chooser lists.
//
// The PLM repository is a JSON file:
//   {
//     "standards": [
//       {"name": "Company drafting standard", "key": "DIF-STD-000101", "unicity": 1}
//     ]
//   }
// "name" is what the chooser and the standard combo show, "key" the unique key kept as the
// current standard; "unicity" (1 when left out) is negative when the repository does not
// guarantee the key to be unique, and the page then refuses the standard.
#pragma once

#include "ZEPHost.h"

#include <string>
#include <vector>

namespace zepapp {

inline constexpr const char* kStandardsFolderEnv = "DRAFTING_OPTIONS_STANDARDS";
inline constexpr const char* kPLMRepositoryEnv = "DRAFTING_OPTIONS_PLM";

// The standards folder: iOption, else $DRAFTING_OPTIONS_STANDARDS, else the resources'
// "standards" folder. Its "drafting" folder holds the drafting standard files.
std::string ResolveStandardsFolder(const std::string& iOption);
// The PLM repository file: iOption, else $DRAFTING_OPTIONS_PLM, else the resources'
// "plm/standards.json". Empty options and variables count as not given.
std::string ResolvePLMRepository(const std::string& iOption);

// Points the standards container at the folder. Empty when the folder holds drafting
// standards, else a sentence saying why none is offered (the folder or its "drafting"
// folder is missing).
std::string UseStandardsFolder(const std::string& iFolder);

// Reads the PLM repository file and gives its standards to the chooser. False, the chooser
// listing nothing, with oError ("path:line:column: what is wrong", or why the file cannot be
// read) for a file that is missing, not a regular file, not JSON or not of the form above.
bool LoadPLMRepository(const std::string& iPath, std::string& oError);

} // namespace zepapp
