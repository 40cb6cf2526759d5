//<![CDATA[
// Shows the rows of the table, some hundred at a time; sorts them by a column and finds text in them.
"use strict";
(() => {
  const data = JSON.parse(document.getElementById("rows").textContent);
  const table = document.getElementById("results");
  const more = document.getElementById("more");
  const find = document.getElementById("find");
  const step = 200;
  const firstFigure = 8; // place in a row; those before it: see below
  const signs = { g: ["good", "✓"], f: ["fair", "▲"], p: ["poor", "✕"], n: ["none", "–"] };

  // Folders are shown from the last one on that all have in common.
  const common = (a, b) => {
    let length = 0;
    while (length < Math.min(a.length, b.length) && a[length] === b[length]) ++length;
    return a.slice(0, length);
  };
  const shared = data.folders.reduce(common).split("/").slice(0, -2).join("/");
  const folders = data.folders.map((folder) => shared ? folder.slice(shared.length + 1) : folder);
  const names = (list) => list.map((index) => data.warnings[index]).join("; ");
  const rows = data.rows.map((row) => ({
    path: data.folders[row[0]], words: [folders[row[0]], row[1], data.maps[row[2]], data.confidences[row[3]]],
    frames: row[4], warnings: names(row[5]), warningCount: row[5].length,
    section: row[6], verdicts: row[7], figures: row.slice(firstFigure),
  }));
  for (const row of rows)
    row.text = (row.path + row.words.slice(1).join(" ") + " " + row.warnings).toLowerCase();
  let order = rows;
  let shown = step;

  const value = (row, column) => column < 4 ? row.words[column] : column === 4 ? row.frames :
    column === 5 ? row.warningCount : row.figures[column - 6];

  function cell(tr, text, style, title) {
    const td = tr.insertCell();
    td.textContent = text;
    if (style) td.className = style;
    if (title) td.title = title;
    return td;
  }

  function build(row) {
    const tr = document.createElement("tr");
    cell(tr, row.words[0], "word", row.path);
    const name = cell(tr, row.section ? "" : row.words[1], "word");
    if (row.section) {
      const link = name.appendChild(document.createElement("a"));
      link.href = "#motion" + row.section;
      link.textContent = row.words[1];
    }
    cell(tr, row.words[2], "word");
    cell(tr, row.words[3], "word");
    cell(tr, row.frames);
    cell(tr, row.warningCount || "", "", row.warnings);
    data.decimals.forEach((decimals, i) => {
      const figure = row.figures[i];
      const [style, sign] = signs[row.verdicts[i] || "n"];
      const td = cell(tr, " " + (figure == null ? "none" : figure.toFixed(decimals)), style);
      td.prepend(Object.assign(document.createElement("em"), { textContent: sign }));
    });
    return tr;
  }

  function show() {
    const text = find.value.trim().toLowerCase();
    const found = text ? order.filter((row) => row.text.includes(text)) : order;
    table.tBodies[0].replaceChildren(...found.slice(0, shown).map(build));
    more.hidden = found.length <= shown;
    const count = Math.min(shown, found.length);
    document.getElementById("shown").textContent =
      count < rows.length ? count.toLocaleString() + " of " + rows.length.toLocaleString() : "";
  }

  const headers = [...table.tHead.rows[0].cells];
  function sort(column) {
    const header = headers[column];
    const down = header.ariaSort === "ascending";
    headers.forEach((other) => other.removeAttribute("aria-sort"));
    header.ariaSort = down ? "descending" : "ascending";
    const sign = down ? -1 : 1;
    order = [...rows].sort((first, second) => {
      const a = value(first, column), b = value(second, column);
      if (a == null || b == null) return (a == null) - (b == null); // always last
      return sign * (typeof a === "string" ? a.localeCompare(b, undefined, { numeric: true }) : a - b);
    });
    show();
  }

  headers.forEach((header, column) => header.firstChild.addEventListener("click", () => sort(column)));
  find.addEventListener("input", () => { shown = step; show(); });
  more.addEventListener("click", () => { shown += 5 * step; show(); });
  show();
})();
//]]>
