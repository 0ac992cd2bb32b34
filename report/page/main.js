// Puts the page together.

function showFacts() {
  byId("made").textContent = data.made;
  const list = (table) => {
    const facts = element("dl");
    const add = (name, value) => facts.append(element("dt", {}, name), element("dd", {}, value));
    table.facts.forEach(([name, value]) => add(name, value));
    return element("div", {}, ...(isPair ? [element("h3", {}, `${table.letter}: ${table.name}`)] : []), facts);
  };
  clear(byId("facts-lists"), element("div", { className: "columns" }, ...tables.map(list)));
}

function showDifference() {
  byId("difference").hidden = false;
  clear(
    byId("difference-table"),
    tableOf(
      ["", "largest", "mean", "root mean square", "largest at"],
      data.difference.map((each, c) => [channelNames[c], brief(each.largest, 6), brief(each.mean, 6), brief(each.rms, 6),
        each.largest === 0 ? "–" : each.at.map((value) => brief(value)).join(" ")]),
    ),
  );
}

function main() {
  document.body.classList.toggle("is-pair", isPair);
  byId("three-version").textContent = THREE.REVISION;
  byId("chart-version").textContent = Chart.version;
  showFacts();
  if (isPair) {
    byId("facts-heading").textContent = "The tables";
    showDifference();
  }
  const views = { curves: new CurveView(), slices: new SliceView(), cloud: new CloudView() };
  showFaults(views);
  showPicture();
  watchTheme();
}

main();
