// The pages drawn as one self-contained HTML file that looks like the options dialog: a tab
// per page, each page laid out on the grid cells of its widgets, padlocks with their tooltips.
#pragma once

#include "ZEPHost.h"

#include <map>
#include <string>
#include <vector>

namespace zepapp {

// A sub-dialog of a page, open, and the push button that opens it.
struct ZEPAppRenderDialog {
  const ZEPDialog* opener = nullptr;
  const ZEPDialog* dialog = nullptr;
};

struct ZEPAppRenderPage {
  std::string name;                 // "grid": anchors and tab ids
  std::string title;                // "Grid"
  const ZEPDialog* frame = nullptr; // the opened page
  std::string note;                 // a line under the page heading; may be empty
  // Drawn as dialogs of their own that their push buttons open.
  std::vector<ZEPAppRenderDialog> dialogs;
  // Why a control the user cannot operate is so, by its operable widget: its tooltip says it.
  std::map<const ZEPDialog*, std::string> whyNot;
  // The control each operable widget is, by name: marked for the live dialog's script
  // (data-control); empty for a picture.
  std::map<const ZEPDialog*, std::string> controlOf;
};

struct ZEPAppRenderContext {
  std::string settingsPath; // shown in the footer; empty: none
  std::string adminPath;
  std::string generator; // "drafting-options 0.1.0"
  std::string adminFault; // the administrator's file could not be read: shown as a banner
};

// The whole document. The first page is the tab shown first; no script, no external resource.
std::string RenderHtml(const std::vector<ZEPAppRenderPage>& iPages,
                       const ZEPAppRenderContext& iContext);

// One page's section of that document, sub-dialogs included.
std::string RenderPageHtml(const ZEPAppRenderPage& iPage);

// Text made safe for HTML content and attribute values.
std::string EscapeHtml(const std::string& iText);

} // namespace zepapp
