#include "ZEPAppServePage.h"

namespace zepapp {

namespace {

const char* const kLiveStyle = R"CSS(
[data-control]{cursor:pointer}
[data-control]:focus-visible{outline:2px solid #3f6fb0;outline-offset:1px}
.push.disabled{pointer-events:auto}
.dialog>.buttons{display:none}
.live-status{margin:0 0 8px;padding:4px 8px;border-radius:3px;font-size:12px;color:#3d4752;background:#e2e7ee}
.live-status.error{background:#fde2e0;color:#8a1c12;font-weight:600}
.live-bubble{position:absolute;z-index:40;pointer-events:none;max-width:380px;padding:4px 8px;border-radius:4px;font-size:12px;line-height:1.3;white-space:pre-line;box-shadow:0 2px 8px rgba(0,0,0,.25)}
.live-bubble.refused{background:#fde2e0;color:#8a1c12;border:1px solid #d9857b}
.live-bubble.note{background:#e6f2e6;color:#1f4d1f;border:1px solid #8fbf8f}
.live-menu{position:absolute;z-index:50;min-width:140px;max-height:50vh;overflow:auto;background:#fff;border:1px solid #7a8390;border-radius:3px;box-shadow:0 4px 14px rgba(0,0,0,.3)}
.live-menu div{padding:3px 10px;white-space:nowrap;cursor:pointer}
.live-menu div:hover,.live-menu div.sel{background:#dbe6f5}
.live-menu input{margin:4px 10px}
input.live-edit{width:110px;font:inherit;border:none;outline:none;padding:2px 6px;text-align:right}
)CSS";

// The page's script. The server's state is the only truth: nothing is drawn as changed
// before the server answers, so a refused change leaves the stored value on screen.
const char* const kLiveScript = R"JS(
(function () {
  'use strict';
  const byPage = {};          // page -> control name -> control
  const drawn = {};           // page -> its section's markup as last drawn
  let ranges = {};            // page -> scale range shown
  let stamp = null;           // the files' stamp of the state on screen
  let generation = 0;         // bumped by every change: older answers are not drawn
  let busy = 0, held = null, pending = null, bubble = null, menu = null;

  const status = document.createElement('div');
  status.className = 'live-status';
  status.setAttribute('role', 'status');
  const body = document.querySelector('.dialog .body');
  if (body) body.insertBefore(status, body.firstChild);

  function say(text, error) {
    status.textContent = text;
    status.classList.toggle('error', !!error);
  }

  async function api(path, data) {
    const init = {headers: {'X-Token': TOKEN}, cache: 'no-store'};
    if (data !== undefined) {
      init.method = 'POST';
      init.headers['Content-Type'] = 'application/json';
      init.body = JSON.stringify(data);
    }
    const response = await fetch(path, init);
    let answer = null;
    try { answer = await response.json(); } catch (e) { answer = null; }
    if (!response.ok) throw new Error((answer && answer.error) || ('the server answered ' + response.status));
    return answer;
  }

  function sectionOf(page) { return document.getElementById('page-' + page); }
  function element(page, name) {
    const section = sectionOf(page);
    return section && section.querySelector('[data-control="' + CSS.escape(name) + '"]');
  }

  // Draws a state: each page's section as the server drew it, its controls marked operable.
  function draw(state) {
    if (held) { pending = state; return; }
    pending = null;
    stamp = state.stamp;
    const shell = document.querySelector('.body > p[role=alert]'); // the banner of the first drawing
    if (shell) shell.remove();
    for (const page of state.pages) {
      const controls = {};
      for (const c of page.controls) controls[c.control] = c;
      byPage[page.page] = controls;
      if (page.range) ranges[page.page] = page.range; else delete ranges[page.page];
      const section = sectionOf(page.page);
      if (section && drawn[page.page] !== page.html) {
        const parent = section.parentElement, scroll = parent ? parent.scrollTop : 0;
        section.outerHTML = page.html;
        if (parent) parent.scrollTop = scroll;
        drawn[page.page] = page.html;
      }
      const now = sectionOf(page.page);
      if (now) for (const el of now.querySelectorAll('[data-control]')) {
        el.tabIndex = 0;
        const c = controls[el.dataset.control];
        if (c) el.setAttribute('aria-disabled', c.enabled ? 'false' : 'true');
      }
    }
    // A sub-dialog is open while its id is the address's fragment; the element drawn anew
    // becomes the fragment's target only when the address is visited again.
    const open = location.hash.length > 1 && document.getElementById(decodeURIComponent(location.hash.slice(1)));
    if (open && !open.matches(':target')) location.replace(location.hash);
    if (state.errors.length) say(state.errors.join('\n') + ' \u2014 no change is accepted until this is corrected.', true);
    else if (state.adminFault) say('The administrator\u2019s settings cannot be read, so no change is accepted: ' + state.adminFault, true);
    else say('Changes are saved at once' + (state.settings ? ' to ' + state.settings : '') +
             (state.warnings.length ? ' \u2014 ' + state.warnings.length + ' stored value(s) not used: ' + state.warnings.join('; ') : '') + '.');
    if (bubble) placeBubble();
  }

  // A message beside a control: why a change was refused, or what a button did.
  function showBubble(page, control, text, kind) {
    closeBubble();
    bubble = {page: page, control: control, text: text, kind: kind, node: null};
    placeBubble();
  }
  function closeBubble() {
    if (bubble && bubble.node) bubble.node.remove();
    bubble = null;
  }
  function container(el) { return el.closest('.subbox') || el.closest('.panels') || document.body; }
  function floatBeside(node, el, below) {
    const box = container(el);
    if (getComputedStyle(box).position === 'static') box.style.position = 'relative';
    box.appendChild(node);
    const r = el.getBoundingClientRect(), b = box.getBoundingClientRect();
    let left = r.right - b.left + box.scrollLeft + 8, top = r.top - b.top + box.scrollTop;
    if (below || left + node.offsetWidth > box.scrollLeft + box.clientWidth) { // a drop-down, or no room on the right
      left = Math.max(0, r.left - b.left + box.scrollLeft);
      top = r.bottom - b.top + box.scrollTop + 3;
    }
    node.style.left = left + 'px';
    node.style.top = top + 'px';
  }
  function placeBubble() {
    if (bubble.node) bubble.node.remove();
    const el = element(bubble.page, bubble.control);
    if (!el) return;
    const node = document.createElement('div');
    node.className = 'live-bubble ' + bubble.kind;
    node.setAttribute('role', bubble.kind === 'refused' ? 'alert' : 'status');
    node.dataset.for = bubble.control;
    node.textContent = bubble.text;
    bubble.node = node;
    floatBeside(node, el);
  }

  function release() {
    held = null;
    if (pending) draw(pending);
  }

  async function send(page, control, value) {
    closeBubble();
    const mine = ++generation;
    busy++;
    try {
      const answer = await api('/api/change', {page: page, control: control.control, value: String(value), ranges: ranges});
      if (mine === generation) draw(answer.state);
      if (!answer.ok) showBubble(page, control.control, answer.message, 'refused');
      else if (control.kind === 'button' && answer.message) showBubble(page, control.control, answer.message, 'note');
    } catch (e) {
      say('The change could not be sent: ' + e.message, true);
    } finally {
      busy--;
    }
  }

  function closeMenu() {
    if (menu) menu.remove();
    menu = null;
    release();
  }
  function openMenu(page, control, el) {
    closeMenu();
    menu = document.createElement('div');
    menu.className = 'live-menu';
    menu.setAttribute('role', 'listbox');
    (control.choices || []).forEach(function (line, i) {
      const item = document.createElement('div');
      item.setAttribute('role', 'option');
      item.textContent = line;
      if (line === control.shown) item.className = 'sel';
      const value = control.values ? control.values[i] : i + 1; // a button's pick sends its value
      item.addEventListener('click', function (ev) { ev.stopPropagation(); closeMenu(); send(page, control, value); });
      menu.appendChild(item);
    });
    if (control.colour) {
      const pick = document.createElement('input');
      pick.type = 'color';
      pick.title = 'Another colour';
      const rgb = /(\d+)\D+(\d+)\D+(\d+)/.exec(control.shown); // "RGB 67,102,85"
      if (rgb) pick.value = '#' + rgb.slice(1).map(function (v) { return ('0' + Number(v).toString(16)).slice(-2); }).join('');
      else if (/^#[0-9a-f]{6}$/i.test(control.shown)) pick.value = control.shown;
      pick.addEventListener('click', function (ev) { ev.stopPropagation(); });
      pick.addEventListener('change', function () { const v = pick.value; closeMenu(); send(page, control, v); });
      menu.appendChild(pick);
    }
    held = 'menu';
    floatBeside(menu, el, true);
  }

  // Typing a value in place, as in a spinner's field; Enter or leaving the field sends it.
  function edit(page, control, el) {
    const field = el.querySelector('.value') || el;
    const input = document.createElement('input');
    input.className = 'live-edit';
    input.value = control.shown;
    input.setAttribute('aria-label', control.title);
    held = 'edit';
    field.textContent = '';
    field.appendChild(input);
    input.focus();
    input.select();
    let done = false;
    function finish(commit) {
      if (done) return;
      done = true;
      const value = input.value;
      input.remove();
      field.textContent = control.shown;
      release();
      if (commit && value.trim() !== control.shown) send(page, control, value);
    }
    input.addEventListener('keydown', function (ev) {
      if (ev.key === 'Enter') { ev.preventDefault(); finish(true); }
      if (ev.key === 'Escape') { ev.preventDefault(); finish(false); }
    });
    input.addEventListener('blur', function () { finish(true); });
    input.addEventListener('click', function (ev) { ev.stopPropagation(); });
  }

  function stepped(control, up) {
    const number = parseFloat(control.shown);
    if (!isFinite(number) || !control.step) return null;
    return String(Number((number + (up ? control.step : -control.step)).toPrecision(12)));
  }

  function operate(page, control, el, target) {
    if (!control.enabled) { // the server says why, as set does
      send(page, control, control.kind === 'check' ? (control.shown === 'on' ? 'off' : 'on') : (control.shown || 'open'));
      return true;
    }
    switch (control.kind) {
      case 'check':
        send(page, control, control.shown === 'on' ? 'off' : 'on');
        return true;
      case 'choice': {
        const radio = target.closest('.radio');
        if (!radio || radio.closest('[data-control]') !== el) return false;
        const radios = Array.from(el.querySelectorAll('.radio')).filter(function (r) { return r.closest('[data-control]') === el; });
        send(page, control, radios.indexOf(radio) + 1);
        return true;
      }
      case 'combo':
        openMenu(page, control, el);
        return true;
      case 'button':
        if (el.tagName === 'A') return false; // its dialog opens in the page
        if (control.values) { // it takes one of the values it offers
          openMenu(page, control, el);
          return true;
        }
        send(page, control, 'open');
        return true;
      case 'spinner': {
        const arrow = target.closest('.arrows > span');
        if (arrow) {
          const value = stepped(control, arrow === arrow.parentElement.firstElementChild);
          if (value !== null) send(page, control, value);
          return true;
        }
        edit(page, control, el);
        return true;
      }
      default: // any other control that takes a typed value
        edit(page, control, el);
        return true;
    }
  }

  document.addEventListener('click', function (ev) {
    if (menu && !menu.contains(ev.target)) closeMenu();
    if (held === 'edit') return;
    const el = ev.target.closest('[data-control]');
    if (!el) { if (!ev.target.closest('.live-bubble')) closeBubble(); return; }
    const section = el.closest('section.page');
    if (!section) return;
    const page = section.id.slice('page-'.length);
    const control = (byPage[page] || {})[el.dataset.control];
    if (!control) return;
    if (operate(page, control, el, ev.target)) ev.preventDefault();
  });
  document.addEventListener('keydown', function (ev) {
    if (ev.key === 'Escape') { closeMenu(); closeBubble(); return; }
    const el = ev.target.closest && ev.target.closest('[data-control]');
    if (!el || held || (ev.key !== 'Enter' && ev.key !== ' ')) return;
    ev.preventDefault();
    el.click();
  });

  // Changes made elsewhere (another program, the command line, a new lock) are drawn as soon
  // as the files' stamp moves.
  async function refresh(force) {
    if (busy) return;
    const mine = generation;
    try {
      if (!force) {
        const now = await api('/api/stamp');
        if (now.stamp === stamp) return;
      }
      const state = await api('/api/state', {ranges: ranges});
      if (mine === generation && !busy) draw(state);
    } catch (e) {
      say('The server does not answer (' + e.message + '); the values shown may be out of date.', true);
    }
  }
  refresh(true);
  setInterval(refresh, 400);
})();
)JS";

void InsertBefore(std::string& ioText, const std::string& iMark, const std::string& iWhat) {
  const std::size_t at = ioText.rfind(iMark);
  if (at != std::string::npos) ioText.insert(at, iWhat);
}

} // namespace

std::string LivePage(const std::string& iDocument, const std::string& iToken, const std::string& iNonce) {
  std::string page = iDocument;
  InsertBefore(page, "</head>",
               "<link rel=\"icon\" href=\"data:,\">\n<style>" + std::string(kLiveStyle) + "</style>\n");
  // The token is hexadecimal and the nonce too: nothing in them needs escaping.
  InsertBefore(page, "</body>",
               "<script nonce=\"" + iNonce + "\">\nconst TOKEN = \"" + iToken + "\";\n" + kLiveScript +
                   "</script>\n");
  return page;
}

} // namespace zepapp
