// The review page: draws the panel, the views browser and the 3D picture from the State
// the host answers, and turns every click, entry, expansion and camera gesture into one
// POST. The page never changes what is displayed on its own: it only redraws what the
// host sends back. Requests go one at a time, in the order the person made them.
'use strict';

(() => {
  const $ = (id) => document.getElementById(id);
  // Changes must carry the token in a header; a reloaded page finds it where the host put it.
  const token = new URLSearchParams(location.search).get('token') ||
      document.querySelector('meta[name="qel-token"]')?.content || null;
  // The host answered the first visit with a cookie; the token need not stay on screen.
  if (token) history.replaceState(null, '', location.pathname);

  // The page's own words (the panel's and the browser's come from the host's catalogs).
  const words = {
    notDone: (reason) => `Not done: ${reason}`,
    counts: (shown, hidden) => `${shown} shown · ${hidden} hidden`,
    unit: (unit) => ` · lengths in ${unit}`,
    more: (names, rest) => `${names} and ${rest} more`,
    hidden: (names) => `Hidden: ${names}`,
    shown: (names) => `Shown: ${names}`,
    expand: (row) => `Expand ${row}`,
    collapse: (row) => `Collapse ${row}`,
    noPanel: 'No panel is open.',
    notRead: (what) => `Not read from the file: ${what}`,
    noItems: 'No views or captures to browse.',
    noPreview: 'No preview',
    notShown: 'Only captures of sets loaded light can be shown',
    capture: 'Capture',
    view: 'View',
    noJson: 'the host answered something that is not JSON',
    filters: 'Filters:',
    noFilter: 'no filter',
    undo: (part) => `Undo: ${part}`,
    reset: 'Reset',
    resetTitle: 'Every facet back to how it read when the model opened',
    notDrawn: (count) => `${count} not drawn`,
    notDrawnMore: (rest) => `and ${rest} more`,
    products: 'Product',
    openPanel: 'Open the panel',
    unplaced: (count, names) => `${count} label(s) not placed, marks only: ${names}`,
    noPicture: 'the picture could not be loaded',
    parts: {
      LeftEditor: 'lower value', LeftCombo: 'lower operator',
      RightCombo: 'upper operator', RightEditor: 'upper value', RangeButton: 'apply the range',
    },
  };

  const view = {
    browserText: '',
    picture: '',        // picture address from the last State, without the size
    pictureWanted: '',  // full address of the newest picture asked for
    activeItem: null,
    rebuilding: false,  // true while the panel's old widgets are being replaced
    serial: 0,          // States applied so far, for tests and measurements
  };

  // ---- requests -------------------------------------------------------------------------

  async function request(path, body) {
    const headers = { Accept: 'application/json' };
    if (token) headers['X-Qel-Token'] = token;
    const init = { method: body === undefined ? 'GET' : 'POST', headers, cache: 'no-store' };
    if (body !== undefined) {
      headers['Content-Type'] = 'application/json';
      init.body = JSON.stringify(body);
    }
    const response = await fetch(path, init);
    const text = await response.text();
    let data = null;
    try {
      data = JSON.parse(text);
    } catch {
      data = null;
    }
    if (!response.ok) {
      const reason = data && data.error ? data.error : text.trim() || response.statusText;
      const error = new Error(`${response.status}: ${reason}`);
      // The box a refused entry is about, marked beside it.
      if (data && data.at) {
        error.at = data.at;
        error.reason = reason;
      }
      throw error;
    }
    if (!data) throw new Error(words.noJson);
    return data;
  }

  let queue = Promise.resolve();
  let waiting = 0;
  // Every change goes through here, so two clicks can never overtake each other. Camera
  // moves and scrolls leave the widgets as they were: their answers skip the panel's rebuild,
  // which at 10k annotations would cost more than comparing the panel's JSON.
  function post(path, body, keepPanel = false) {
    waiting += 1;
    document.body.setAttribute('aria-busy', 'true');
    // Resolves true once the answer is drawn, false when the host refused the request.
    const run = queue.then(() => request(path, body)).then((state) => {
      apply(state, keepPanel);
      return true;
    }, (error) => {
      showError(error);
      return false;
    }).finally(() => {
      waiting -= 1;
      if (waiting === 0) document.body.removeAttribute('aria-busy');
    });
    queue = run;
    return run;
  }

  function sendEvent(id, type, extra) {
    return post('/api/event', Object.assign({ id, type }, extra || {}));
  }

  function showError(error) {
    const status = $('status');
    status.textContent = words.notDone(error.message);
    status.classList.add('error');
    if (error.at) markBox(error.at, error.reason);
  }

  function markBox(id, reason) {
    const box = $('panel').querySelector(`[data-wid="${CSS.escape(id)}"]`);
    if (!box) return;
    box.classList.add('invalid');
    box.setAttribute('aria-invalid', 'true');
    box.title = reason;
    const note = el('span', 'box-error', reason);
    note.setAttribute('role', 'alert');
    note.id = `why-${id}`;
    box.setAttribute('aria-describedby', note.id);
    box.after(note);
  }

  // ---- State ----------------------------------------------------------------------------

  function apply(state, keepPanel = false) {
    // The picture is asked for first: the host renders it while the page draws the panel.
    if (state.picture && state.picture !== view.picture) {
      view.picture = state.picture;
      loadPicture();
    }
    $('status').classList.remove('error');
    setText($('status'), '');
    if (!keepPanel) drawPanel(state.panel);
    drawFilters(state.filters, !!state.panel);
    drawNotDrawn(state.notDrawn, keepPanel);
    drawProducts(state.products);
    drawBrowser(state.browser);
    drawDisplay(state.display, state.changes, state.unit);
    const unplaced = state.unplaced || [];
    const named = unplaced.length > 6 ? words.more(unplaced.slice(0, 6).join(', '), unplaced.length - 6) : unplaced.join(', ');
    setText($('unplaced'), unplaced.length ? words.unplaced(unplaced.length, named) : '');
    drawNotRead(state.notRead);
    view.serial += 1;
    document.body.dataset.serial = String(view.serial);
    if (state.question) ask(state.question);
  }

  // One button per filter in effect: a click undoes it. Reset brings the opening state.
  function drawFilters(filters, hasPanel) {
    const host = $('filters');
    const parts = [el('span', 'filters-head', words.filters)];
    if (!filters || filters.length === 0) parts.push(el('span', 'filter none', words.noFilter));
    for (const part of filters || []) {
      if (!part.undo) {
        parts.push(el('span', 'filter', part.text));
        continue;
      }
      const button = el('button', 'filter', `${part.text} ✕`);
      button.type = 'button';
      button.title = words.undo(part.text);
      button.setAttribute('aria-label', words.undo(part.text));
      button.addEventListener('click', () => sendEvent(part.undo, 'click'));
      parts.push(button);
    }
    const reset = el('button', 'reset', words.reset);
    reset.type = 'button';
    reset.id = 'reset';
    reset.title = words.resetTitle;
    reset.disabled = !hasPanel;
    reset.addEventListener('click', () => post('/api/reset', {}));
    parts.push(reset);
    host.replaceChildren(...parts);
  }

  // The annotations not drawn, each with why; a row of the panel standing for one says the
  // same when hovered.
  function drawNotDrawn(notDrawn, keepPanel) {
    const box = $('not-drawn');
    if (!notDrawn) return;
    const open = box.open;
    const items = notDrawn.listed.map((entry) => {
      const item = el('li');
      item.appendChild(el('b', null, entry.name));
      item.appendChild(document.createTextNode(`: ${entry.why.join('; ')}`));
      return item;
    });
    if (notDrawn.count > notDrawn.listed.length) items.push(el('li', null, words.notDrawnMore(notDrawn.count - notDrawn.listed.length)));
    const summary = el('summary', null, words.notDrawn(notDrawn.count));
    const list = el('ul');
    list.append(...items);
    box.replaceChildren(summary, list);
    box.open = open;
    if (keepPanel) return;
    const why = new Map(notDrawn.listed.map((entry) => [entry.row, `${entry.name}: ${entry.why.join('; ')}`]));
    $('panel').querySelectorAll('.row.property').forEach((row) => {
      const caption = row.querySelector(':scope > label.caption');
      const text = caption ? caption.textContent.trim() : '';
      if (why.has(text)) {
        row.title = why.get(text);
        row.classList.add('not-drawn');
      }
    });
  }

  // The product tree: a click makes a product UI-active, and the browser follows it.
  function drawProducts(products) {
    const host = $('products');
    if (!products || products.length < 2) {
      host.replaceChildren();
      return;
    }
    const list = el('ul', 'products');
    list.setAttribute('aria-label', words.products);
    for (const product of products) {
      const item = el('li');
      item.style.paddingLeft = `${product.depth}em`;
      const button = el('button', 'product', product.name);
      button.type = 'button';
      button.setAttribute('aria-pressed', String(product.active));
      button.addEventListener('click', () => post('/api/ui-active', { product: product.product }));
      item.appendChild(button);
      list.appendChild(item);
    }
    host.replaceChildren(list);
  }

  // Texts are set only when they differ: an equal text set again still counts as a change
  // for the page's layout and for a screen reader's live region.
  function setText(node, text) {
    if (node.textContent !== text) node.textContent = text;
  }

  // What the model's file held and was not read stays in sight above the panes, so that
  // nobody takes the panel for the whole file.
  function drawNotRead(notRead) {
    const text = (notRead || []).map((n) => {
      const ids = n.entities && n.entities.length
        ? ` (${n.entities.join(', ')}${n.entities.length < n.count ? ', …' : ''})` : '';
      return `${n.count} ${n.kind}${ids}`;
    }).join('; ');
    let box = $('not-read');
    if (!box && !text) return;
    if (!box) {
      box = document.createElement('p');
      box.id = 'not-read';
      box.className = 'status error';
      $('status').after(box);
    }
    setText(box, text ? words.notRead(text) : '');
    box.hidden = !text;
  }

  function drawDisplay(display, changes, unit) {
    setText($('display-summary'), display ? words.counts(display.shown, display.hidden) + (unit ? words.unit(unit) : '') : '');
    const parts = [];
    const list = (names) => (names.length > 6
      ? words.more(names.slice(0, 6).join(', '), names.length - 6) : names.join(', '));
    if (changes && changes.hidden && changes.hidden.length) parts.push(words.hidden(list(changes.hidden)));
    if (changes && changes.shown && changes.shown.length) parts.push(words.shown(list(changes.shown)));
    setText($('changes'), parts.join(' — '));
    $('changes').title = parts.join('\n');
  }

  // ---- the panel ------------------------------------------------------------------------

  const el = (tag, className, text) => {
    const node = document.createElement(tag);
    if (className) node.className = className;
    if (text) node.textContent = text;
    return node;
  };

  // A row is shaded when its background leans away from the base colour (alternate rows).
  function isShaded(color) {
    return Array.isArray(color) && color[3] > 0 && !(color[0] === 255 && color[1] === 255 && color[2] === 255);
  }

  // Icons are names; the page draws a few known ones as small marks and leaves the rest out.
  function drawIcon(name) {
    const base = String(name || '').split(/[\\/]/).pop().replace(/\.png$/, '');
    if (!base || /EmptyIcon$/.test(base)) return null;
    const icon = el('span', 'icon');
    icon.dataset.icon = base;
    icon.setAttribute('aria-hidden', 'true');
    return icon;
  }

  function rowText(node) {
    const label = (node.children || []).find((c) => c.kind === 'Label' && c.visible && c.attributes.text);
    return label ? label.attributes.text : '';
  }

  function drawWidget(node, disabled, context) {
    if (!node.visible) return null;
    const off = disabled || !node.enabled;
    const dom = drawKind(node, off, context);
    if (!dom) return null;
    dom.dataset.wid = node.id;
    if (off) dom.classList.add('disabled');
    if (node.row !== undefined) {
      dom.style.gridRow = String(node.row + 1);
      dom.style.gridColumn = String((node.column || 0) + 1);
    }
    return dom;
  }

  function drawChildren(node, into, disabled, context) {
    for (const child of node.children || []) {
      const dom = drawWidget(child, disabled, context);
      if (dom) into.appendChild(dom);
    }
    return into;
  }

  function drawKind(node, off, context) {
    const text = node.attributes.text || '';
    switch (node.kind) {
      case 'Spacer':
        return null;
      case 'Label': {
        if (!text) return drawIcon(node.attributes.icon);
        return el('label', 'label', text);
      }
      case 'Button': {
        const button = el('button', 'button', text);
        button.type = 'button';
        button.disabled = off;
        if (context.row && words.parts[node.name]) button.setAttribute('aria-label', `${context.row}: ${words.parts[node.name]}`);
        // Closing is kept for the next start: the person is asked first.
        if (node.name === 'CloseButton') button.addEventListener('click', () => confirmClose(node.id));
        else button.addEventListener('click', () => sendEvent(node.id, 'click'));
        return button;
      }
      case 'CheckButton': {
        const radio = node.attributes.radio === 1;
        const state = node.attributes.checked || 0;
        const input = el('input', radio ? 'radio' : 'check');
        input.type = radio ? 'radio' : 'checkbox';
        input.id = `w${node.id}`;
        input.checked = state === 1;
        input.indeterminate = !radio && state === 2;
        input.disabled = off;
        // The host decides: the box shows its new state only once the host has applied it.
        input.addEventListener('click', (event) => {
          event.preventDefault();
          sendEvent(node.id, 'click');
        });
        if (!text) return input;
        const label = el('label', 'label');
        label.append(input, document.createTextNode(` ${text}`));
        return label;
      }
      case 'LineEditor':
        return drawEditor(node, off, context);
      case 'Combo': {
        const select = el('select', 'combo');
        (node.lines || []).forEach((line, index) => {
          const option = el('option', null, line);
          option.value = String(index);
          select.appendChild(option);
        });
        select.selectedIndex = node.selectedIndex;
        select.disabled = off;
        select.setAttribute('aria-label', context.row ? `${context.row}: ${words.parts[node.name] || node.name}` : node.name);
        select.addEventListener('change', () => {
          const index = select.selectedIndex;
          select.selectedIndex = node.selectedIndex;
          sendEvent(node.id, 'select', { index });
        });
        return select;
      }
      case 'Expander':
        return drawExpander(node, off, context);
      case 'Grid': {
        const grid = el('div', 'grid');
        return drawChildren(node, grid, off, context);
      }
      case 'ScrollableArea': {
        const area = el('div', 'scroll');
        area.addEventListener('scroll', () => reportScroll(node.id, area));
        return drawChildren(node, area, off, context);
      }
      case 'Frame': {
        const isRow = node.attributes.layout === 'row';
        const frame = el('div', isRow ? 'row' : 'frame');
        if (isRow && isShaded(node.attributes.background)) frame.classList.add('shaded');
        if (isRow && (node.children || []).some((c) => c.kind === 'CheckButton' && c.visible)) frame.classList.add('property');
        if (isRow && (node.children || []).some((c) => c.kind === 'LineEditor' && c.visible)) frame.classList.add('range');
        const inner = isRow ? { row: rowText(node) || context.row } : context;
        drawChildren(node, frame, off, inner);
        if (isRow) labelRow(frame);
        return frame;
      }
      default: {
        // The docked panel itself and any container the page has no special form for.
        const box = el('div', 'box');
        if (node.kind === 'Panel' && text) {
          const title = el('div', 'panel-title');
          const icon = drawIcon(node.attributes.icon);
          if (icon) title.appendChild(icon);
          title.appendChild(el('span', null, text));
          box.appendChild(title);
        }
        return drawChildren(node, box, off, context);
      }
    }
  }

  // The row's caption names its check box, so clicking the words ticks the box.
  function labelRow(frame) {
    const input = frame.querySelector(':scope > input[type=checkbox], :scope > input[type=radio]');
    const caption = frame.querySelector(':scope > label.label');
    if (caption) caption.classList.add('caption');
    if (input && caption) caption.htmlFor = input.id;
  }

  function drawEditor(node, off, context) {
    const input = el('input', 'editor');
    input.type = 'text';
    input.inputMode = 'decimal';
    input.autocomplete = 'off';
    input.spellcheck = false;
    input.value = node.attributes.text || '';
    input.disabled = off;
    input.size = 6;
    input.setAttribute('aria-label', context.row ? `${context.row}: ${words.parts[node.name] || node.name}` : node.name);
    const shown = input.value;
    let sent = shown;
    // An entry goes once: Enter then Tab, or a rebuild removing the box, sends nothing more.
    const commit = () => {
      if (input.value === sent || !input.isConnected || view.rebuilding) return;
      sent = input.value;
      delete input.dataset.typing;
      sendEvent(node.id, 'text', { text: sent });
    };
    input.addEventListener('input', () => { input.dataset.typing = '1'; });
    input.addEventListener('keydown', (event) => {
      if (event.key === 'Enter') {
        event.preventDefault();
        commit();
      } else if (event.key === 'Escape') {
        input.value = shown;
        delete input.dataset.typing;
      }
    });
    input.addEventListener('blur', commit);
    return input;
  }

  function drawExpander(node, off, context) {
    const children = node.children || [];
    const expanded = node.expanded !== false;
    // The host makes the header the first child and the body the last.
    const header = children.length > 1 ? children[0] : null;
    const body = children.length > 0 ? children[children.length - 1] : null;
    const box = el('div', header ? 'expander' : 'expander section');
    const head = el('div', 'expander-head');
    const toggle = el('button', 'toggle');
    toggle.type = 'button';
    toggle.setAttribute('aria-expanded', String(expanded));
    const title = node.attributes.text || '';
    if (header) {
      const headerDom = drawWidget(header, off, context);
      toggle.setAttribute('aria-label', (expanded ? words.collapse : words.expand)(rowText(header)).trim());
      head.appendChild(toggle);
      if (headerDom) head.appendChild(headerDom);
      if (headerDom && headerDom.classList.contains('shaded')) head.classList.add('shaded');
    } else {
      const icon = drawIcon(node.attributes.icon);
      if (icon) toggle.appendChild(icon);
      toggle.appendChild(el('span', 'section-title', title || node.name));
      const heading = el('h3', 'section-heading');
      heading.appendChild(toggle);
      head.appendChild(heading);
    }
    toggle.addEventListener('click', () => sendEvent(node.id, expanded ? 'collapse' : 'expand'));
    box.appendChild(head);
    if (expanded && body) {
      const bodyDom = drawWidget(body, off, context);
      if (bodyDom) {
        bodyDom.classList.add('expander-body');
        box.appendChild(bodyDom);
      }
    }
    return box;
  }

  let scrollTimer = 0;
  // The dialog keeps its scroll offsets across rebuilds: tell it where the person is.
  function reportScroll(id, area) {
    if (area.dataset.restoring) return;
    clearTimeout(scrollTimer);
    scrollTimer = setTimeout(() => {
      post('/api/event', { id, type: 'scroll', x: Math.round(area.scrollLeft), y: Math.round(area.scrollTop) }, true);
    }, 400);
  }

  function drawPanel(panel) {
    const host = $('panel');
    // What the person was doing survives the rebuild: scroll offsets, focus, a half-typed entry.
    const scrolls = new Map();
    host.querySelectorAll('.scroll').forEach((area) => scrolls.set(area.dataset.wid, [area.scrollLeft, area.scrollTop]));
    const focused = document.activeElement && host.contains(document.activeElement) ? document.activeElement : null;
    const focusId = focused ? focused.closest('[data-wid]')?.dataset.wid : null;
    const focusToggle = focused ? focused.classList.contains('toggle') : false;
    const typing = focused && focused.matches('input.editor') && focused.dataset.typing
      ? { value: focused.value, start: focused.selectionStart, end: focused.selectionEnd } : null;

    const root = panel ? drawWidget(panel, false, {}) : noPanel();
    view.rebuilding = true;
    host.replaceChildren(root || noPanel());
    view.rebuilding = false;
    // The containers above the scrolled area share the pane's height, so only the rows scroll.
    for (let node = host.querySelector('.scroll'); node && node !== host; node = node.parentElement) {
      node.classList.add('fill');
    }

    host.querySelectorAll('.scroll').forEach((area) => {
      const kept = scrolls.get(area.dataset.wid);
      // A new area starts at the top: setting nothing spares a layout in the middle of the draw.
      if (!kept || (kept[0] === 0 && kept[1] === 0)) return;
      area.dataset.restoring = '1';
      area.scrollLeft = kept[0];
      area.scrollTop = kept[1];
      requestAnimationFrame(() => delete area.dataset.restoring);
    });
    if (focusId) {
      const owner = host.querySelector(`[data-wid="${CSS.escape(focusId)}"]`);
      let target = null;
      if (owner) {
        target = focusToggle ? owner.querySelector('.toggle')
          : owner.matches('input, select, button') ? owner : owner.querySelector('input, select, button');
      }
      if (target && !target.disabled) {
        target.focus({ preventScroll: true });
        if (typing && target.matches('input.editor')) {
          target.value = typing.value;
          target.dataset.typing = '1';
          target.setSelectionRange(typing.start, typing.end);
        }
      }
    }
  }

  // Without a panel the page offers to open it again: nobody needs a command line for it.
  function noPanel() {
    const box = el('div', 'empty');
    box.appendChild(el('p', null, words.noPanel));
    const open = el('button', 'open-panel', words.openPanel);
    open.type = 'button';
    open.id = 'open-panel';
    open.addEventListener('click', () => post('/api/open-panel', {}));
    box.appendChild(open);
    return box;
  }

  function confirmClose(id) {
    const dialog = $('close-question');
    dialog.returnValue = '';
    dialog.onclose = () => {
      if (dialog.returnValue === 'yes') sendEvent(id, 'click');
    };
    dialog.showModal();
  }

  // ---- the views browser ----------------------------------------------------------------

  function drawBrowser(browser) {
    const text = JSON.stringify(browser);
    if (text === view.browserText) return;
    view.browserText = text;
    const host = $('browser');
    if (!browser || !browser.nodes || browser.nodes.length === 0) {
      host.replaceChildren(el('p', 'empty', words.noItems));
      return;
    }
    const columns = browser.columns || [];
    const nodes = browser.nodes.map((node) => {
      const section = el('section', 'node');
      section.appendChild(el('h3', 'node-name', node.name));
      const list = el('ul', 'items');
      for (const item of node.items) {
        const entry = el('li');
        const button = el('button', `item ${item.kind}`);
        button.type = 'button';
        button.dataset.item = String(item.item);
        button.setAttribute('aria-pressed', String(view.activeItem === item.item));
        let thumb;
        if (item.thumbnail) {
          thumb = el('img', 'thumb');
          thumb.alt = '';
          thumb.loading = 'lazy';
          thumb.decoding = 'async';
          thumb.width = 112;
          thumb.height = 84;
          thumb.src = item.thumbnail;
        } else {
          thumb = el('span', 'thumb none', words.noPreview);
        }
        const about = el('span', 'item-text');
        about.appendChild(el('span', 'item-name', item.name));
        about.appendChild(el('span', 'item-kind', item.kind === 'capture' ? words.capture : words.view));
        if (item.description) {
          const description = el('span', 'item-description');
          if (columns[1]) description.appendChild(el('span', 'column', `${columns[1]}: `));
          description.appendChild(document.createTextNode(item.description));
          about.appendChild(description);
        }
        button.append(thumb, about);
        // Only a capture with an item adapter (a light set's) can be activated.
        if (item.kind !== 'capture' || !item.thumbnail) {
          button.disabled = true;
          button.title = words.notShown;
        }
        button.addEventListener('click', () => activate(item.item));
        entry.appendChild(button);
        list.appendChild(entry);
      }
      section.appendChild(list);
      return section;
    });
    host.replaceChildren(...nodes);
  }

  function activate(item) {
    return post('/api/activate', { item }).then((done) => {
      if (!done) return;
      view.activeItem = item;
      $('browser').querySelectorAll('button.item').forEach((b) => {
        b.setAttribute('aria-pressed', String(b.dataset.item === String(item)));
      });
    });
  }

  // ---- the picture ----------------------------------------------------------------------

  // The box's size as last laid out, kept by its observer so that asking for a picture never
  // makes the page lay itself out in the middle of drawing an answer.
  const pictureBox = { width: 0, height: 0 };
  function pictureSize() {
    const clamp = (v) => Math.max(64, Math.min(2048, Math.round(v)));
    if (!pictureBox.width) {
      const box = $('picture-box');
      pictureBox.width = box.clientWidth;
      pictureBox.height = box.clientHeight;
    }
    return [clamp(pictureBox.width), clamp(pictureBox.height)];
  }

  // The newest picture replaces the old one only once it has arrived, so nothing flickers; the
  // element that loaded it is the one put in place, so it is loaded and decoded once. It is
  // fetched, not left to an image element, which would start loading after the answer is drawn.
  function loadPicture() {
    if (!view.picture) return;
    const [w, h] = pictureSize();
    const url = `${view.picture}${view.picture.includes('?') ? '&' : '?'}w=${w}&h=${h}`;
    if (url === view.pictureWanted) return;
    view.pictureWanted = url;
    document.body.dataset.picture = 'loading';
    const headers = token ? { 'X-Qel-Token': token } : {};
    let next = null;
    fetch(url, { cache: 'no-store', headers }).then((response) => {
      if (!response.ok) throw new Error(`${response.status}`);
      return response.blob();
    }).then((blob) => {
      if (view.pictureWanted !== url) return;
      next = new Image();
      return new Promise((resolve, reject) => {
        next.onload = resolve;
        next.onerror = reject;
        next.src = URL.createObjectURL(blob);
      });
    }).then(() => {
      if (!next) return;
      if (view.pictureWanted !== url) {
        URL.revokeObjectURL(next.src);
        return;
      }
      const shown = $('picture');
      next.id = shown.id;
      next.alt = shown.alt;
      next.draggable = false;
      shown.replaceWith(next);
      if (shown.src.startsWith('blob:')) URL.revokeObjectURL(shown.src);
      document.body.dataset.picture = 'ready';
    }).catch(() => {
      if (next) URL.revokeObjectURL(next.src);
      if (view.pictureWanted !== url) return;
      document.body.dataset.picture = 'failed';
      showError(new Error(words.noPicture));
    });
  }

  // Gestures pile up while a camera request is on its way and go as one.
  const camera = { busy: false, dx: 0, dy: 0, zoom: 1 };
  function flushCamera() {
    if (camera.busy) return;
    let body = null;
    if (camera.dx || camera.dy) {
      const limit = (v) => Math.max(-360, Math.min(360, v));
      body = { orbit: [limit(camera.dx), limit(camera.dy)] };
      camera.dx = 0;
      camera.dy = 0;
    } else if (camera.zoom !== 1) {
      body = { zoom: Math.max(0.01, Math.min(100, camera.zoom)) };
      camera.zoom = 1;
    }
    if (!body) return;
    camera.busy = true;
    post('/api/camera', body, true).finally(() => {
      camera.busy = false;
      flushCamera();
    });
  }
  const degreesPerPixel = 0.4;
  function orbit(dx, dy) {
    camera.dx += dx;
    camera.dy += dy;
    flushCamera();
  }
  function zoom(factor) {
    camera.zoom *= factor;
    flushCamera();
  }

  function setUpPicture() {
    const box = $('picture-box');
    let drag = null;
    box.addEventListener('pointerdown', (event) => {
      if (event.button !== 0) return;
      drag = { x: event.clientX, y: event.clientY };
      box.setPointerCapture(event.pointerId);
      box.classList.add('dragging');
    });
    box.addEventListener('pointermove', (event) => {
      if (!drag) return;
      const dx = event.clientX - drag.x;
      const dy = event.clientY - drag.y;
      drag = { x: event.clientX, y: event.clientY };
      orbit(dx * degreesPerPixel, dy * degreesPerPixel);
    });
    const stop = () => {
      drag = null;
      box.classList.remove('dragging');
    };
    box.addEventListener('pointerup', stop);
    box.addEventListener('pointercancel', stop);
    box.addEventListener('wheel', (event) => {
      event.preventDefault();
      const notches = event.deltaMode === 0 ? event.deltaY / 100 : event.deltaY / 3;
      zoom(1.25 ** -notches);
    }, { passive: false });
    box.addEventListener('keydown', (event) => {
      const step = 10;
      const keys = {
        ArrowLeft: () => orbit(-step, 0), ArrowRight: () => orbit(step, 0),
        ArrowUp: () => orbit(0, -step), ArrowDown: () => orbit(0, step),
        '+': () => zoom(1.25), '=': () => zoom(1.25), '-': () => zoom(0.8),
      };
      if (!keys[event.key]) return;
      event.preventDefault();
      keys[event.key]();
    });
    $('zoom-in').addEventListener('click', () => zoom(1.25));
    $('zoom-out').addEventListener('click', () => zoom(0.8));
    $('reframe').addEventListener('click', () => post('/api/camera', { reframe: true }, true));
    let resizeTimer = 0;
    new ResizeObserver(([entry]) => {
      pictureBox.width = entry.target.clientWidth;
      pictureBox.height = entry.target.clientHeight;
      clearTimeout(resizeTimer);
      resizeTimer = setTimeout(loadPicture, 150);
    }).observe(box);
  }

  // ---- the question ---------------------------------------------------------------------

  function ask(question) {
    const dialog = $('question');
    $('question-title').textContent = question.title;
    $('question-message').textContent = question.message;
    if (!dialog.open) dialog.showModal();
  }

  function setUpQuestion() {
    const dialog = $('question');
    // Escape closes the dialog without a value: that is a "no".
    dialog.addEventListener('close', () => {
      post('/api/answer', { answer: dialog.returnValue === 'yes' ? 'yes' : 'no' });
      dialog.returnValue = '';
    });
  }

  // ---- start ----------------------------------------------------------------------------

  setUpPicture();
  setUpQuestion();
  queue = request('/api/state').then(apply, showError);
})();
