// The list of faults, and the way from a fault to its place in the curves, the slices and the cloud.

/** The curve that a place lies on, or -1. */
function curveThrough(colour) {
  const isSame = (a, b) => Math.abs(a - b) < 1e-6;
  return curves.findIndex(({ channel, base }) =>
    channel < 0
      ? colour.every((value) => isSame(value, colour[0]))
      : colour.every((value, c) => c === channel || isSame(value, base[c])));
}

function showFault(fault, views) {
  const colour = fault.from.map((value, c) => (fault.kind === "clip" || Number.isNaN(fault.to[c]) ? value : (value + fault.to[c]) / 2));
  const point = colour.map((value, c) => nearestIndex(gridInputs[c], value));
  views.slices.goTo(...point);
  views.cloud.mark(point);
  const curve = curveThrough(colour);
  const isOnCurve = curve >= 0;
  if (isOnCurve) {
    const { channel } = curves[curve];
    views.curves.choose(curve);
    views.curves.goTo(colour[channel < 0 ? 1 : channel]);
  }
  byId(isOnCurve ? "curves" : "slices").scrollIntoView({
    behavior: matchMedia("(prefers-reduced-motion: reduce)").matches ? "auto" : "smooth",
  });
}

/** A text whose colours stay on one line. */
function unbroken(text) {
  return text.replace(/(?<=\d) (?=-?\d)/g, "\u00a0");
}

function showFaults(views) {
  clear(byId("fault-lists"), element("div", { className: "columns" }, ...tables.map((table) => {
    const heading = isPair ? [element("h3", {}, `${table.letter}: ${table.name}`)] : [];
    if (table.faults === null) return element("div", {}, ...heading, element("p", {}, "Not looked for."));
    if (table.faults.length === 0) {
      return element("div", {}, ...heading, element("p", { className: "none" },
        "None found: every sample is a number, nothing folds back, jumps or clips, and neutrals stay neutral."));
    }
    const items = table.faults.map((fault) => {
      const button = element("button", { type: "button" }, element("span", { className: "kind" }, fault.kind), unbroken(fault.text));
      button.addEventListener("click", () => showFault(fault, views));
      return element("li", {}, button);
    });
    return element("div", {}, ...heading, element("ul", { className: "faults" }, ...items));
  })));
}
