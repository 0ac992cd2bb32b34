// Making parts of the page. Texts go in as texts, never as markup.

function byId(id) {
  return document.getElementById(id);
}

/** element("td", {className: "x"}, "text", child, ...) */
function element(name, properties = {}, ...children) {
  const made = Object.assign(document.createElement(name), properties);
  made.append(...children);
  return made;
}

function clear(parent, ...children) {
  parent.replaceChildren(...children);
}

/** Fills a fieldset with radio buttons; the first is chosen. */
function choices(fieldset, names, onChoice) {
  names.forEach((name, index) => {
    const input = element("input", { type: "radio", name: fieldset.id, value: String(index), checked: index === 0 });
    input.addEventListener("change", () => onChoice(index));
    fieldset.append(element("label", {}, input, name));
  });
  return (index) => {
    fieldset.querySelectorAll("input")[index].checked = true;
    onChoice(index);
  };
}

function tableOf(headings, rows) {
  const cells = (name, texts) => texts.map((text) => element(name, {}, text));
  return element(
    "table",
    {},
    element("thead", {}, element("tr", {}, ...cells("th", headings))),
    element("tbody", {}, ...rows.map((row) => element("tr", {}, ...cells("td", row)))),
  );
}

/** A label and the values of a colour, in one piece; with a swatch of it where `shown` is given. */
function reading(label, values, shown) {
  const swatch = element("span", { className: "swatch" });
  if (shown) swatch.style.background = cssColour(Array.from(shown));
  return element("span", { className: "reading" }, element("b", {}, label), " ", ...(shown ? [swatch] : []), values);
}

/** Calls with the event of a pointer that moves over a canvas, and of a finger that taps on it. */
function onPointer(canvas, follow) {
  canvas.addEventListener("pointerdown", follow);
  canvas.addEventListener("pointermove", follow);
}

/** The style sheet's colours, as they are now. */
function theme() {
  const style = getComputedStyle(document.documentElement);
  const named = (name) => style.getPropertyValue(`--${name}`).trim();
  return {
    channels: channelNames.map(named),
    pales: channelNames.map((name) => named(`pale-${name}`)),
    ink: named("ink"),
    quiet: named("quiet"),
    rule: named("rule"),
    identity: named("identity"),
    space: named("space"),
    card: named("card"),
  };
}

const redraws = [];

/** Draws now, and again whenever the colours of the page change. */
function drawn(draw) {
  redraws.push(draw);
  draw();
}

function watchTheme() {
  const redraw = () => redraws.forEach((draw) => draw());
  matchMedia("(prefers-color-scheme: dark)").addEventListener("change", redraw);
  addEventListener("beforeprint", redraw);
  addEventListener("afterprint", redraw);
  matchMedia("print").addEventListener("change", redraw);
}
