// The folding tree beside the pages of an object dump. A tree page says what is in it:
//
//   Node1 = gFld("Hips", "OrnHTML1.htm target=mainFrame");
//   Node2 = insFld(Node1, gFld("Chest", "OrnHTML2.htm target=mainFrame"));
//   initializeDocument(Node1)
//
// Rows are made when their branch is opened, so that large scenes open at once.
"use strict";

const kTargetMark = " target=";
const kRowHeight = "1.4em";

// An entry of its own, not yet in a tree.
function gFld(name, link) {
  const mark = link.lastIndexOf(kTargetMark);
  return {
    name: name || "(no name)",
    href: mark < 0 ? link : link.slice(0, mark),
    target: mark < 0 ? "_self" : link.slice(mark + kTargetMark.length),
    children: [],
  };
}

// Hangs an entry under another one.
function insFld(parent, entry) {
  parent.children.push(entry);
  return entry;
}

// Shows a tree with its first level open.
function initializeDocument(root) {
  addStyle();
  const list = makeList("tree");
  list.append(makeRow(root));
  list.addEventListener("click", onClick);
  list.addEventListener("keydown", onKey);
  document.body.append(list);
  openRow(list.firstChild);
  list.firstChild.tabIndex = 0;
}

function addStyle() {
  const style = document.createElement("style");
  style.textContent = `
    body { font: 14px sans-serif; margin: 8px; }
    ul { list-style: none; margin: 0; padding: 0; }
    ul ul { margin-left: 9px; border-left: 1px solid #ccc; padding-left: 8px; }
    li { outline: none; }
    li > div { display: flex; white-space: nowrap; line-height: ${kRowHeight}; border-radius: 3px; }
    li:focus > div { background: #d7e6f7; }
    li[aria-selected=true] > div > a { font-weight: bold; }
    li[aria-expanded=false] > ul { display: none; }
    span { width: 16px; cursor: pointer; user-select: none; flex: none; }
    li[aria-expanded=true] > div > span::before { content: "\\25be"; }
    li[aria-expanded=false] > div > span::before { content: "\\25b8"; }
    a { color: #14427a; text-decoration: none; padding: 0 3px; }
    a:hover { text-decoration: underline; }`;
  document.head.append(style);
}

function makeList(role) {
  const list = document.createElement("ul");
  list.setAttribute("role", role);
  return list;
}

function makeRow(entry) {
  const row = document.createElement("li");
  row.entry = entry;
  row.tabIndex = -1;
  row.setAttribute("role", "treeitem");
  if (entry.children.length > 0)
    row.setAttribute("aria-expanded", "false");
  const link = document.createElement("a");
  link.textContent = entry.name;
  link.href = entry.href;
  link.target = entry.target;
  link.tabIndex = -1;
  const line = document.createElement("div");
  line.append(document.createElement("span"), link);
  row.append(line);
  return row;
}

function isOpen(row) {
  return row.getAttribute("aria-expanded") === "true";
}

function openRow(row) {
  if (row.entry.children.length === 0)
    return;
  if (!row.querySelector(":scope > ul")) {
    const list = makeList("group");
    list.append(...row.entry.children.map(makeRow));
    row.append(list);
  }
  row.setAttribute("aria-expanded", "true");
}

function closeRow(row) {
  if (isOpen(row))
    row.setAttribute("aria-expanded", "false");
}

function focusOn(row) {
  if (!row)
    return;
  const before = document.querySelector("li[tabindex='0']");
  if (before)
    before.tabIndex = -1;
  row.tabIndex = 0;
  row.focus();
  row.firstChild.scrollIntoView({ block: "nearest" });
}

function selectRow(row) {
  const before = document.querySelector("li[aria-selected=true]");
  if (before)
    before.removeAttribute("aria-selected");
  row.setAttribute("aria-selected", "true");
}

function onClick(event) {
  const row = event.target.closest("li");
  if (!row)
    return;
  if (event.target.tagName === "A")
    selectRow(row);
  else if (event.target.tagName === "SPAN")
    isOpen(row) ? closeRow(row) : openRow(row);
  focusOn(row);
}

function parentRow(row) {
  return row.parentElement.closest("li");
}

// The row below, as it is seen.
function nextRow(row) {
  if (isOpen(row))
    return row.querySelector("li");
  while (row && !row.nextElementSibling)
    row = parentRow(row);
  return row && row.nextElementSibling;
}

function lastRowOf(row) {
  while (isOpen(row))
    row = row.lastElementChild.lastElementChild;
  return row;
}

function previousRow(row) {
  const before = row.previousElementSibling;
  return before ? lastRowOf(before) : parentRow(row);
}

const kKeys = {
  ArrowDown: (row) => focusOn(nextRow(row)),
  ArrowUp: (row) => focusOn(previousRow(row)),
  ArrowRight: (row) => (isOpen(row) ? focusOn(row.querySelector("li")) : openRow(row)),
  ArrowLeft: (row) => (isOpen(row) ? closeRow(row) : focusOn(parentRow(row))),
  Home: () => focusOn(document.querySelector("li")),
  End: () => focusOn(lastRowOf(document.querySelector("li"))),
  Enter: (row) => row.querySelector("a").click(),
};

function onKey(event) {
  const act = kKeys[event.key];
  const row = event.target.closest("li");
  if (!act || !row || event.ctrlKey || event.altKey || event.metaKey)
    return;
  event.preventDefault();
  act(row);
}
