// The live dialog's page: the document render draws, with the style and the script that make
// it live (each user action sent to the server, the state it answers drawn at once, the files
// watched for changes made elsewhere).
#pragma once

#include <string>

namespace zepapp {

// iDocument: RenderHtml's output, its operable elements marked with data-control. iToken goes
// with every request of the script; iNonce is the one script the page's security policy runs.
std::string LivePage(const std::string& iDocument, const std::string& iToken, const std::string& iNonce);

} // namespace zepapp
