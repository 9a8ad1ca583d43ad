"use strict";
// Sorts the table by its headings and shows the rows that hold every word of the filter.
(() => {
  const table = document.getElementById("files");
  const body = table.tBodies[0];
  const rows = [...body.rows];
  const texts = new Map(rows.map(row => [row, row.textContent.toLowerCase()]));
  const status = document.getElementById("shown");
  const filter = document.getElementById("filter");

  function show() {
    const words = filter.value.toLowerCase().split(/\s+/).filter(Boolean);
    let shown = 0;
    for (const row of rows) {
      row.hidden = !words.every(word => texts.get(row).includes(word));
      shown += !row.hidden;
    }
    status.textContent = `${shown} of ${rows.length} files`;
  }

  const key = (row, column) => {
    const cell = row.cells[column];
    return cell.dataset.value === undefined ? cell.textContent.toLowerCase() : Number(cell.dataset.value);
  };
  const compare = (a, b) => typeof a === "number" ? a - b : a.localeCompare(b, "en", {numeric: true});

  for (const heading of table.tHead.rows[0].cells) {
    const button = heading.querySelector("button");
    if (!button) continue;
    button.addEventListener("click", () => {
      const down = heading.getAttribute("aria-sort") === "ascending";
      for (const other of table.tHead.rows[0].cells) other.removeAttribute("aria-sort");
      heading.setAttribute("aria-sort", down ? "descending" : "ascending");
      const column = heading.cellIndex;
      rows.sort((a, b) => (down ? -1 : 1) * compare(key(a, column), key(b, column)));
      body.append(...rows);
    });
  }
  filter.addEventListener("input", show);
  document.getElementById("tools").hidden = false;
  show();
})();
