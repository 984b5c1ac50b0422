#include "ZEPAppRender.h"

#include "ZEPDrwLockDialog.h"

#include <cstdio>
#include <cctype>
#include <sstream>

namespace zepapp {

std::string EscapeHtml(const std::string& iText) {
  std::string out;
  out.reserve(iText.size());
  for (char c : iText) {
    switch (c) {
    case '&':
      out += "&amp;";
      break;
    case '<':
      out += "&lt;";
      break;
    case '>':
      out += "&gt;";
      break;
    case '"':
      out += "&quot;";
      break;
    case '\'':
      out += "&#39;";
      break;
    default:
      out += c;
    }
  }
  return out;
}

namespace {

const char* const kClosedLock = "\xF0\x9F\x94\x92"; // U+1F512
const char* const kOpenLock = "\xF0\x9F\x94\x93";   // U+1F513

// Padlocks are drawn rather than left to an emoji font the reader may lack; the emoji stays
// in the text for copying and searching.
std::string Padlock(bool iLocked) {
  const char* shackle =
      iLocked ? "M4.5 7.5V5a3.5 3.5 0 0 1 7 0v2.5" : "M11 7.5V3.8a3 3 0 0 0-6 0v.9";
  return std::string("<svg viewBox=\"0 0 16 16\" width=\"14\" height=\"14\" "
                     "aria-hidden=\"true\"><path d=\"") +
         shackle +
         "\" fill=\"none\" stroke=\"currentColor\" stroke-width=\"1.7\"/><rect x=\"2.5\" y=\"7\" " +
         "width=\"11\" height=\"8\" rx=\"1.6\" fill=\"currentColor\"/></svg><span class=\"sr\">" +
         (iLocked ? kClosedLock : kOpenLock) + "</span>";
}

const char* const kStyle = R"CSS(
*{box-sizing:border-box}
body{margin:0;padding:28px;background:#5b6e86;font:13px/1.35 "Segoe UI",Tahoma,"DejaVu Sans",Arial,sans-serif;color:#1b1b1b}
.captioned{display:inline-flex;align-items:center;gap:6px}
.dialog{max-width:980px;margin:0 auto;background:#eceef1;border:1px solid #2f3b4c;border-radius:6px;box-shadow:0 10px 30px rgba(0,0,0,.35);overflow:hidden;min-width:0}
.titlebar{display:flex;align-items:center;gap:8px;padding:7px 12px;background:linear-gradient(#3f6fb0,#2d548c);color:#fff;font-weight:600}
.titlebar .icon{display:inline-block;width:16px;height:16px;border-radius:3px;background:#f4c542;box-shadow:inset 0 0 0 2px #d39e12}
.titlebar .close{margin-left:auto;width:20px;height:18px;border-radius:3px;background:#c9443a;text-align:center;line-height:17px;font-size:12px}
.body{padding:12px 14px 4px}
.tabs{display:flex;flex-wrap:wrap;gap:2px;padding-left:6px;position:relative;top:1px}
.tabs label{padding:5px 14px;border:1px solid #9aa3ae;border-bottom:none;border-radius:5px 5px 0 0;background:#d8dce2;color:#333;cursor:pointer}
.tabs label:hover{background:#e4e7eb}
input.tab{position:absolute;opacity:0;pointer-events:none}
.panels{border:1px solid #9aa3ae;background:#f7f8f9;border-radius:0 4px 4px 4px;padding:12px 16px 16px;height:min(74vh,820px);min-height:260px;overflow:auto}
.page{display:none}
.page h2{margin:0 0 2px;font-size:15px;font-weight:600;color:#203656}
.page .note{margin:0 0 8px;color:#56606c;font-size:12px}
.grid{display:grid;align-items:center;justify-items:start;justify-content:start;gap:5px 14px}
.pagegrid{display:grid;gap:10px;justify-items:stretch;align-items:start;margin-top:8px}
.lockable{display:grid;grid-template-columns:20px auto;align-items:center;gap:0 4px}
fieldset.section{margin:0;padding:6px 12px 10px;border:1px solid #b8bfc8;border-radius:4px;background:#fff}
fieldset.section legend{padding:0 6px;font-weight:600;color:#203656}
.padlock{display:inline-flex;align-items:center;justify-content:center;width:20px;height:18px;cursor:help}
.padlock.open{color:#a9b1bb}
.padlock.locked{color:#b7791f}
.sr{position:absolute;width:1px;height:1px;overflow:hidden;clip:rect(0 0 0 0);white-space:nowrap}
.spacer{display:inline-block;width:20px}
.check,.radio{display:inline-flex;align-items:center;gap:6px;white-space:nowrap}
.check .box{width:14px;height:14px;border:1px solid #7a8390;border-radius:2px;background:#fff;display:inline-flex;align-items:center;justify-content:center;font-size:11px;line-height:1;color:#1d5fb4;font-weight:700}
.radio .box{width:14px;height:14px;border:1px solid #7a8390;border-radius:50%;background:#fff;display:inline-flex;align-items:center;justify-content:center}
.radio.on .box::after{content:"";width:6px;height:6px;border-radius:50%;background:#1d5fb4}
.spinner,.combo,.editor{display:inline-flex;align-items:stretch;border:1px solid #8f98a4;border-radius:3px;background:#fff;min-height:22px}
.spinner .value{min-width:84px;padding:2px 6px;text-align:right;font-variant-numeric:tabular-nums}
.spinner .arrows{display:flex;flex-direction:column;border-left:1px solid #c3c9d0;background:#eef0f3;width:15px;font-size:7px;line-height:10px;text-align:center;color:#444}
.combo .value{min-width:120px;padding:2px 6px;display:inline-flex;align-items:center;gap:5px}
.combo .drop{border-left:1px solid #c3c9d0;background:#eef0f3;width:18px;text-align:center;font-size:9px;line-height:20px;color:#444}
.editor .value{min-width:120px;padding:2px 6px}
.push{display:inline-block;padding:3px 14px;border:1px solid #7a8390;border-radius:3px;background:linear-gradient(#fdfdfd,#e3e6ea)}
.label{white-space:nowrap}
.disabled,.disabled .value{color:#9097a0}
.disabled .box,.spinner.disabled,.combo.disabled,.editor.disabled{background:#eef0f2;border-color:#c3c8cf}
.spinner.disabled .arrows,.combo.disabled .drop{color:#b0b5bb}
.hidden{visibility:hidden}
.footer{display:flex;flex-wrap:wrap;gap:4px 18px;padding:8px 14px 10px;color:#4b5561;font-size:12px}
.footer code{font-family:"DejaVu Sans Mono",Consolas,monospace;font-size:11px;background:#e0e4e9;padding:0 4px;border-radius:3px}
.buttons{display:flex;justify-content:flex-end;gap:8px;padding:0 14px 12px}
.buttons span{min-width:74px;text-align:center}
fieldset.radios{margin:0;padding:2px 8px 6px;border:1px solid #c7cdd5;border-radius:3px}
fieldset.radios legend{padding:0 4px;color:#203656}
.panels:has(:target) .page{display:none!important}
.panels .page:target,.panels .page:has(:target){display:block!important}
a.push{color:inherit;text-decoration:none;cursor:pointer}
.push.disabled{pointer-events:none}
.subdialog{display:none;position:fixed;inset:0;z-index:10;background:rgba(20,30,45,.35);align-items:center;justify-content:center}
.subdialog:target{display:flex}
.subbox{min-width:320px;max-width:92vw;max-height:92vh;overflow:auto;background:#eceef1;border:1px solid #2f3b4c;border-radius:6px;box-shadow:0 10px 30px rgba(0,0,0,.45)}
.subbox .pagegrid{padding:10px 14px}
.titlebar a.close{color:#fff;text-decoration:none}
.colour{display:inline-flex;align-items:center;gap:4px}
.swatch{display:inline-block;width:14px;height:14px;border:1px solid #7a8390;border-radius:2px}
.disabled .swatch{opacity:.45}
@media print{.page{display:block;margin-bottom:18px}.tabs{display:none}body{background:#fff}}
)CSS";

// Long numbers grouped by thousands for reading: "100000 mm" becomes "100 000 mm" (narrow
// no-break spaces), decimals untouched.
std::string Grouped(const std::string& iText) {
  std::size_t begin = iText.find_first_of("0123456789");
  if (begin == std::string::npos) return iText;
  std::size_t end = begin;
  while (end < iText.size() && std::isdigit(static_cast<unsigned char>(iText[end]))) ++end;
  if (end - begin <= 4 || (begin > 0 && iText[begin - 1] == '.')) return iText;
  std::string digits = iText.substr(begin, end - begin), out;
  for (std::size_t i = 0; i < digits.size(); ++i) {
    if (i > 0 && (digits.size() - i) % 3 == 0) out += "\xE2\x80\xAF";
    out += digits[i];
  }
  return iText.substr(0, begin) + out + iText.substr(end);
}

std::string CellStyle(const ZEPDialog& w) {
  const ZEPDialog::Cell& c = w.GetGridConstraints();
  if (!c.set) return "";
  const int width = c.width > 0 ? c.width : 1;
  const int height = c.height > 0 ? c.height : 1;
  std::ostringstream s;
  s << "grid-row:" << c.row + 1 << " / span " << height << ";grid-column:" << c.column + 1
    << " / span " << width;
  return s.str();
}

// Class, name, tooltip and cell of an element; the tooltip of a control the user cannot
// operate says why (locked by whom and where, or which control keeps it disabled).
std::string Attributes(const ZEPDialog& w, const ZEPAppRenderPage& iPage, std::string iClass, std::string iTooltip) {
  if (auto why = iPage.whyNot.find(&w); why != iPage.whyNot.end() && !why->second.empty())
    iTooltip += (iTooltip.empty() ? "" : "\n") + why->second;
  const bool hidden = w.GetVisibility() == ZEPDlgHide;
  if (hidden)
    iClass += " hidden";
  else if (!w.IsEffectivelyEnabled() && !ZEPSysDynamicCast<ZEPDlgLock>(const_cast<ZEPDialog*>(&w)))
    iClass += " disabled";
  std::string out = " class=\"" + iClass + "\" data-name=\"" + EscapeHtml(w.GetOwnName()) + "\"";
  if (auto control = iPage.controlOf.find(&w); control != iPage.controlOf.end())
    out += " data-control=\"" + EscapeHtml(control->second) + "\"";
  if (!iTooltip.empty()) out += " title=\"" + EscapeHtml(iTooltip) + "\"";
  const std::string style = CellStyle(w);
  if (!style.empty()) out += " style=\"" + style + "\"";
  return out;
}

std::string Tooltip(const ZEPDialog& w) {
  return !w.GetLongHelp().IsEmpty() ? w.GetLongHelp().str() : w.GetShortHelp().str();
}

void Render(const ZEPDialog& w, const ZEPAppRenderPage& iPage, std::string& out);

void Children(const ZEPDialog& w, const ZEPAppRenderPage& iPage, std::string& out) {
  for (const ZEPDialog* child : w.GetChildren())
    Render(*child, iPage, out);
}

std::string DialogId(const ZEPAppRenderPage& iPage, const ZEPDialog& iDialog) {
  return "dlg-" + iPage.name + "-" + iDialog.GetOwnName();
}

// A sub-dialog: a box of its own over the page, shown while its id is the address's fragment.
void RenderDialog(const ZEPAppRenderPage& iPage, const ZEPDialog& iDialog, std::string& out) {
  const std::string title =
      EscapeHtml(iDialog.GetTitle().IsEmpty() ? iDialog.GetOwnName() : iDialog.GetTitle().str());
  out += "<div class=\"subdialog\" id=\"" + EscapeHtml(DialogId(iPage, iDialog)) +
         "\" role=\"dialog\" aria-label=\"" + title +
         "\"><div class=\"subbox\"><div class=\"titlebar\"><span class=\"icon\"></span>" + title +
         "<a class=\"close\" href=\"#\" aria-label=\"Close\">&#10005;</a></div><div "
         "class=\"pagegrid\">";
  Children(iDialog, iPage, out);
  out += "</div><div class=\"buttons\"><a class=\"push\" href=\"#\">Close</a></div></div></div>\n";
}

// The icons of combo lines that tell where a line comes from (the main page's standard combo):
// drawn, with a word for the tooltip and for readers without the picture.
struct LineIcon {
  const char* name;
  const char* word;
  const char* drawing;
};
const LineIcon kLineIcons[] = {
    {"I_D3M_Folder", "standard file",
     "<path d=\"M1.5 4.5h5l1.5 1.5h6.5v7.5h-13z\" fill=\"#e8b64c\" stroke=\"#9a7321\"/>"},
    {"I_D3M_Database", "PLM standard",
     "<ellipse cx=\"8\" cy=\"4\" rx=\"5.5\" ry=\"2\" fill=\"#7fa7d9\" stroke=\"#2d548c\"/><path d=\"M2.5 "
     "4v8c0 1.1 2.5 2 5.5 2s5.5-.9 5.5-2V4\" fill=\"#7fa7d9\" stroke=\"#2d548c\"/>"},
};

const LineIcon* FindLineIcon(const ZEPDlgCombo& iCombo, int iLine) {
  ZEPString icon;
  if (iCombo.GetLineIconName(icon, iLine) < 0 || icon.empty()) return nullptr;
  for (const LineIcon& i : kLineIcons)
    if (icon == i.name) return &i;
  return nullptr;
}

void RenderCombo(const ZEPDialog& w, const ZEPAppRenderPage& iPage, const ZEPDlgCombo& combo, std::string& out) {
  std::string lines, selected;
  const LineIcon* selectedIcon = nullptr;
  for (int i = 0; i < combo.GetLineCount(); ++i) {
    ZEPUnicodeString text;
    combo.GetLine(text, i);
    const LineIcon* icon = FindLineIcon(combo, i);
    lines += (i ? "\n" : "") +
             std::string(i == combo.GetSelect() ? "\xE2\x97\x8F " : "\xE2\x97\x8B ") + text.str() +
             (icon ? std::string(" (") + icon->word + ")" : std::string());
    if (i == combo.GetSelect()) {
      selected = text.str();
      selectedIcon = icon;
    }
  }
  std::string tip = w.GetTitle().str();
  if (!Tooltip(w).empty()) tip += (tip.empty() ? "" : ": ") + Tooltip(w);
  tip += (tip.empty() ? "" : "\n") + lines;
  // A combo of its own (the scale range combo) gets its caption beside it.
  const bool captioned = !w.GetTitle().IsEmpty() && !dynamic_cast<const ZEPDrwLockDialog*>(w.GetParentDialog()) &&
                         !ZEPSysDynamicCast<ZEPDlgFrame>(const_cast<ZEPDialog*>(&w));
  if (captioned) {
    const std::string cell = CellStyle(w);
    out += "<span class=\"captioned\"" + (cell.empty() ? std::string() : " style=\"" + cell + "\"") +
           "><span class=\"label\">" + EscapeHtml(w.GetTitle().str()) + ":</span>";
  }
  std::string icon;
  if (selectedIcon)
    icon = std::string("<svg class=\"lineicon\" data-icon=\"") + selectedIcon->name +
           "\" viewBox=\"0 0 16 16\" width=\"14\" height=\"14\" aria-hidden=\"true\">" + selectedIcon->drawing +
           "</svg><span class=\"sr\">" + selectedIcon->word + ": </span>";
  out += "<span" + Attributes(w, iPage, "combo", tip) + "><span class=\"value\">" + icon + EscapeHtml(selected) +
         "</span><span class=\"drop\">&#9660;</span></span>";
  if (captioned) out += "</span>";
}

void Render(const ZEPDialog& w, const ZEPAppRenderPage& iPage, std::string& out) {
  auto* self = const_cast<ZEPDialog*>(&w);
  if (ZEPSysDynamicCast<ZEPDlgWindow>(self)) return; // a sub-dialog: drawn after the page
  if (auto* lock = ZEPSysDynamicCast<ZEPDlgLock>(self)) {
    const bool locked = lock->IsLocked();
    std::string tip =
        locked ? (lock->GetLockText().empty() ? "Locked by an administrator" : lock->GetLockText())
               : "Not locked: this setting can be changed";
    out += "<span" + Attributes(w, iPage, locked ? "padlock locked" : "padlock open", tip) +
           " aria-label=\"" + (locked ? "locked" : "not locked") + "\">" + Padlock(locked) +
           "</span>";
    return;
  }
  if (auto* section = ZEPSysDynamicCast<ZEPDlgToolsOptionsFrame>(self)) {
    out += "<fieldset" + Attributes(w, iPage, "section", "") + "><legend>" +
           EscapeHtml(section->GetTitle().str()) + "</legend>";
    for (const ZEPDialog* child : w.GetChildren()) {
      out += "<div class=\"grid\">";
      Children(*child, iPage, out); // the options frame's controls
      out += "</div>";
    }
    out += "</fieldset>";
    return;
  }
  if (auto* check = ZEPSysDynamicCast<ZEPDlgCheckButton>(self)) {
    if (w.GetVisibility() == ZEPDlgHide) { // a padlock-sized placeholder
      out += "<span" + Attributes(w, iPage, "spacer", "") + "></span>";
      return;
    }
    const bool on = check->GetState() == ZEPDlgChecked;
    out += "<span" + Attributes(w, iPage, on ? "check on" : "check", Tooltip(w)) +
           "><span class=\"box\">" + (on ? "&#10003;" : "") + "</span><span class=\"text\">" +
           EscapeHtml(w.GetTitle().str()) + "</span></span>";
    return;
  }
  if (auto* radio = ZEPSysDynamicCast<ZEPDlgRadioButton>(self)) {
    const bool on = radio->GetState() == ZEPDlgChecked;
    out += "<span" + Attributes(w, iPage, on ? "radio on" : "radio", Tooltip(w)) +
           "><span class=\"box\"></span><span class=\"text\">" + EscapeHtml(w.GetTitle().str()) +
           "</span></span>";
    return;
  }
  if (auto* spinner = ZEPSysDynamicCast<ZEPDlgSpinner>(self)) {
    std::string tip = w.GetTitle().str();
    if (!Tooltip(w).empty()) tip += (tip.empty() ? "" : ": ") + Tooltip(w);
    out += "<span" + Attributes(w, iPage, "spinner", tip) + "><span class=\"value\">" +
           EscapeHtml(Grouped(spinner->FormatValue(spinner->GetValue()))) +
           "</span><span class=\"arrows\"><span>&#9650;</span><span>&#9660;</span></span></span>";
    return;
  }
  if (auto* colour = ZEPSysDynamicCast<ZEPComboColor>(self)) {
    // The selected colour as a swatch before the combo's line.
    unsigned int rgb[3] = {0, 0, 0};
    char hex[8] = "";
    if (colour->GetSelectedColor(&rgb[0], &rgb[1], &rgb[2]))
      std::snprintf(hex, sizeof hex, "#%02X%02X%02X", rgb[0] & 0xFF, rgb[1] & 0xFF, rgb[2] & 0xFF);
    std::string tip = w.GetTitle().str();
    if (!Tooltip(w).empty()) tip += (tip.empty() ? "" : ": ") + Tooltip(w);
    out += "<span" + Attributes(w, iPage, "colour", tip) + ">";
    if (*hex)
      out += "<span class=\"swatch\" style=\"background:" + std::string(hex) + "\" title=\"" +
             hex + "\"></span>";
    Children(w, iPage, out);
    out += "</span>";
    return;
  }
  if (ZEPSysDynamicCast<ZEPNumberedCombo>(self)) { // line weights and the like: titled
    std::string tip = w.GetTitle().str();
    if (!Tooltip(w).empty()) tip += (tip.empty() ? "" : ": ") + Tooltip(w);
    out += "<span" + Attributes(w, iPage, "numbered", tip) + ">";
    Children(w, iPage, out);
    out += "</span>";
    return;
  }
  if (auto* combo = ZEPSysDynamicCast<ZEPDlgCombo>(self)) {
    RenderCombo(w, iPage, *combo, out);
    return;
  }
  if (auto* editor = ZEPSysDynamicCast<ZEPDlgEditor>(self)) {
    std::string tip = w.GetTitle().str();
    if (!Tooltip(w).empty()) tip += (tip.empty() ? "" : ": ") + Tooltip(w);
    out += "<span" + Attributes(w, iPage, "editor", tip) + "><span class=\"value\">" +
           EscapeHtml(editor->GetText().str()) + "</span></span>";
    return;
  }
  if (ZEPSysDynamicCast<ZEPDlgPushButton>(self)) {
    for (const ZEPAppRenderDialog& d : iPage.dialogs)
      if (d.opener == &w && d.dialog) {
        out += "<a href=\"#" + EscapeHtml(DialogId(iPage, *d.dialog)) + "\"" +
               Attributes(w, iPage, "push", Tooltip(w)) + ">" + EscapeHtml(w.GetTitle().str()) + "</a>";
        return;
      }
    out += "<span" + Attributes(w, iPage, "push", Tooltip(w)) + ">" + EscapeHtml(w.GetTitle().str()) +
           "</span>";
    return;
  }
  if (ZEPSysDynamicCast<ZEPDlgLabel>(self)) {
    out += "<span" + Attributes(w, iPage, "label", Tooltip(w)) + ">" + EscapeHtml(w.GetTitle().str()) +
           "</span>";
    return;
  }
  // A frame: its own grid. Lock-aware controls keep the padlock column narrow.
  bool hasLock = false;
  for (const ZEPDialog* child : w.GetChildren())
    hasLock = hasLock || ZEPSysDynamicCast<ZEPDlgLock>(const_cast<ZEPDialog*>(child)) ||
              (ZEPSysDynamicCast<ZEPDlgCheckButton>(const_cast<ZEPDialog*>(child)) &&
               child->GetVisibility() == ZEPDlgHide);
  bool radios = false;
  for (const ZEPDialog* child : w.GetChildren())
    radios = radios || ZEPSysDynamicCast<ZEPDlgRadioButton>(const_cast<ZEPDialog*>(child));
  if (radios && !w.GetTitle().IsEmpty()) { // a radio group under its caption
    out += "<fieldset" + Attributes(w, iPage, "grid radios", Tooltip(w)) + "><legend>" +
           EscapeHtml(w.GetTitle().str()) + "</legend>";
    Children(w, iPage, out);
    out += "</fieldset>";
    return;
  }
  out += "<div" + Attributes(w, iPage, hasLock ? "lockable" : "grid", "") + ">";
  Children(w, iPage, out);
  out += "</div>";
}

} // namespace

std::string RenderPageHtml(const ZEPAppRenderPage& iPage) {
  const ZEPAppRenderPage& p = iPage;
  std::string out = "<section class=\"page\" id=\"page-" + EscapeHtml(p.name) +
                    "\" role=\"tabpanel\">\n<h2>" + EscapeHtml(p.title) + "</h2>\n";
  if (!p.note.empty()) out += "<p class=\"note\">" + EscapeHtml(p.note) + "</p>\n";
  if (p.frame) {
    out += "<div class=\"pagegrid\">";
    Children(*p.frame, p, out);
    out += "</div>\n";
  }
  for (const ZEPAppRenderDialog& d : p.dialogs)
    if (d.dialog) RenderDialog(p, *d.dialog, out);
  out += "</section>\n";
  return out;
}

std::string RenderHtml(const std::vector<ZEPAppRenderPage>& iPages,
                       const ZEPAppRenderContext& iContext) {
  std::string out;
  out += "<!DOCTYPE html>\n<html lang=\"en\">\n<head>\n<meta charset=\"utf-8\">\n";
  out += "<meta name=\"generator\" content=\"" + EscapeHtml(iContext.generator) + "\">\n";
  out += "<title>Drafting options</title>\n<style>" + std::string(kStyle);
  // Each tab shows its page while its radio button is checked.
  for (const ZEPAppRenderPage& p : iPages) {
    const std::string id = EscapeHtml(p.name);
    out += "#tab-" + id + ":checked~.panels #page-" + id + "{display:block}\n";
    out += "#tab-" + id + ":checked~.tabs label[for=tab-" + id + "],.body:has(#page-" + id +
           ":target) .tabs label[for=tab-" + id + "]{background:#f7f8f9;color:#000;font-weight:600;padding-bottom:6px}\n";
  }
  out +=
      "</style>\n</head>\n<body>\n<div class=\"dialog\" role=\"dialog\" aria-label=\"Options\">\n";
  out += "<div class=\"titlebar\"><span class=\"icon\"></span>Options &#8211; Drafting<span "
         "class=\"close\">"
         "&#10005;</span></div>\n<div class=\"body\">\n";
  if (!iContext.adminFault.empty())
    out += "<p class=\"note\" role=\"alert\" style=\"color:#a00000;font-weight:600\">The administrator&#39;s "
           "settings cannot be read, so no change is accepted until they are corrected: " +
           EscapeHtml(iContext.adminFault) + "</p>\n";
  bool first = true;
  for (const ZEPAppRenderPage& p : iPages) {
    out += "<input class=\"tab\" type=\"radio\" name=\"page\" id=\"tab-" + EscapeHtml(p.name) +
           "\"" + (first ? " checked" : "") + ">\n";
    first = false;
  }
  out += "<div class=\"tabs\" role=\"tablist\">";
  for (const ZEPAppRenderPage& p : iPages)
    out += "<label for=\"tab-" + EscapeHtml(p.name) + "\" role=\"tab\">" + EscapeHtml(p.title) +
           "</label>";
  out += "</div>\n<div class=\"panels\">\n";
  for (const ZEPAppRenderPage& p : iPages) out += RenderPageHtml(p);
  out += "</div>\n</div>\n<div class=\"footer\">";
  out += "<span>Settings: <code>" +
         EscapeHtml(iContext.settingsPath.empty() ? "none (not saved)" : iContext.settingsPath) +
         "</code></span>";
  out += "<span>Administrator&#39;s settings: <code>" +
         EscapeHtml(iContext.adminPath.empty() ? "none" : iContext.adminPath) + "</code></span>";
  out += "<span><span class=\"padlock locked\">" + Padlock(true) +
         "</span>locked (hover for who and where) &#183; <span class=\"padlock open\">" +
         Padlock(false) + "</span>not locked &#183; greyed: not available</span>";
  out += "</div>\n<div class=\"buttons\"><span class=\"push\">OK</span><span "
         "class=\"push\">Cancel</span></div>\n";
  out += "</div>\n</body>\n</html>\n";
  return out;
}

} // namespace zepapp
