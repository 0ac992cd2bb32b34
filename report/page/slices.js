// Slices of the lattice along blue: what the table makes of the plane of red and green.

const lattices = tables.map((table) => new Lattice(data.grid, table.lattice, table.extent));
const gridInputs = data.grid.inputs;

function gridColour(r, g, b) {
  return [gridInputs[0][r], gridInputs[1][g], gridInputs[2][b]];
}

/** The largest distance of two colours on a channel; infinite where one is no number. */
function apart(a, b) {
  const distance = Math.max(...a.map((value, c) => Math.abs(value - b[c])));
  return Number.isNaN(distance) ? Infinity : distance;
}

/** Black by way of violet and orange to white: rises evenly in lightness, for every colour vision. */
function heat(part) {
  const stops = [[0, 0, 4], [87, 16, 110], [188, 55, 84], [249, 142, 9], [252, 255, 164]];
  const place = Math.min(Math.max(part, 0), 1) * (stops.length - 1);
  const below = Math.min(Math.floor(place), stops.length - 2);
  return stops[below].map((from, c) => Math.round(from + (stops[below + 1][c] - from) * (place - below)));
}

/** What is drawn side by side: the bytes of a point. What is no number is magenta. */
const sliceKinds = [
  ...tables.map((table, t) => ({
    name: isPair ? `${table.letter}: ${table.name}` : table.name,
    bytes: (element) => {
      const colour = lattices[t].colour(element);
      return colour.some(Number.isNaN) ? [255, 0, 255] : screenColour(colour);
    },
  })),
  isPair
    ? {
        name: `Difference of the channel that differs most: white is ${brief(data.differenceFull)}`,
        bytes: (element) => heat(apart(lattices[0].colour(element), lattices[1].colour(element)) / data.differenceFull),
      }
    : {
        name: [0, 1].every((end, i) => [data.grid.min, data.grid.max][i].every((value) => value === end))
          ? "Without the table"
          : "Without the table: the domain from black to white",
        bytes: (element, place) => screenColour(place.map((value, c) => (value - data.grid.min[c]) / (data.grid.max[c] - data.grid.min[c]))),
      },
];

function drawSlice(canvas, kind, b) {
  const [width, height] = data.grid.size;
  canvas.width = width;
  canvas.height = height;
  const context = canvas.getContext("2d");
  const image = context.createImageData(width, height);
  for (let g = 0; g < height; ++g) {
    for (let r = 0; r < width; ++r) {
      const bytes = kind.bytes(lattices[0].element(r, g, b), gridColour(r, g, b));
      image.data.set([...bytes, 255], 4 * ((height - 1 - g) * width + r));
    }
  }
  context.putImageData(image, 0, 0);
}

class SliceView {
  constructor() {
    const [width, height, depth] = data.grid.size;
    this.blue = Math.floor((depth - 1) / 2);
    this.place = { r: Math.floor((width - 1) / 2), g: Math.floor((height - 1) / 2) };
    this.views = sliceKinds.map((kind) => this.view(kind));
    this.slider = byId("slice-blue");
    this.slider.max = String(depth - 1);
    this.slider.addEventListener("input", () => this.goTo(this.place.r, this.place.g, Number(this.slider.value)));
    this.makeSheet();
    this.goTo(this.place.r, this.place.g, this.blue);
  }

  view(kind) {
    const canvas = element("canvas", { tabIndex: 0, role: "img", ariaLabel: `${kind.name}. Arrow keys move; the value is below.` });
    const mark = element("div", { className: "mark" });
    byId("slice-views").append(
      element("figure", {}, element("div", { className: "slice" }, canvas, mark), element("figcaption", {}, kind.name)),
    );
    const [width, height] = data.grid.size;
    onPointer(canvas, (event) => {
      const r = Math.floor((event.offsetX / canvas.clientWidth) * width);
      const g = height - 1 - Math.floor((event.offsetY / canvas.clientHeight) * height);
      this.goTo(r, g, this.blue);
    });
    canvas.addEventListener("keydown", (event) => {
      const steps = { ArrowLeft: [-1, 0, 0], ArrowRight: [1, 0, 0], ArrowUp: [0, 1, 0], ArrowDown: [0, -1, 0], PageUp: [0, 0, 1], PageDown: [0, 0, -1] };
      const step = steps[event.key];
      if (!step) return;
      event.preventDefault();
      this.goTo(this.place.r + step[0], this.place.g + step[1], this.blue + step[2]);
    });
    return { kind, canvas, mark };
  }

  /** Small slices over the whole of blue: an overview, and what paper has instead of a slider. */
  makeSheet() {
    const depth = data.grid.size[2];
    const count = Math.min(9, depth);
    const sheet = element("div", { className: "sheet" });
    this.sheet = Array.from({ length: count }, (_, i) => {
      const b = count === 1 ? 0 : Math.round((i * (depth - 1)) / (count - 1));
      const canvas = element("canvas");
      drawSlice(canvas, isPair ? sliceKinds[2] : sliceKinds[0], b);
      const button = element("button", { type: "button", ariaLabel: `Slice at blue ${brief(gridInputs[2][b])}` }, canvas);
      button.addEventListener("click", () => this.goTo(this.place.r, this.place.g, b));
      sheet.append(button);
      return { b, button };
    });
    const name = isPair ? "The difference over the whole of blue" : "Slices over the whole of blue";
    byId("slice-views").append(element("figure", {}, sheet, element("figcaption", {}, name)));
  }

  goTo(r, g, b) {
    const limit = (index, axis) => Math.min(Math.max(index, 0), data.grid.size[axis] - 1);
    const isNewSlice = limit(b, 2) !== this.blue || !this.isDrawn;
    this.place = { r: limit(r, 0), g: limit(g, 1) };
    this.blue = limit(b, 2);
    if (isNewSlice) this.views.forEach(({ kind, canvas }) => drawSlice(canvas, kind, this.blue));
    this.isDrawn = true;
    this.showPlace();
  }

  showPlace() {
    const { r, g } = this.place;
    const [width, height] = data.grid.size;
    this.slider.value = String(this.blue);
    byId("slice-blue-value").textContent = brief(gridInputs[2][this.blue]);
    this.sheet.forEach(({ b, button }) => { button.ariaPressed = String(b === this.blue); });
    this.views.forEach(({ mark }) => {
      mark.style.left = `${((r + 0.5) / width) * 100}%`;
      mark.style.top = `${((height - 0.5 - g) / height) * 100}%`;
    });
    const element3D = lattices[0].element(r, g, this.blue);
    const input = element("span", { id: "slice-in" }, triple(gridColour(r, g, this.blue), exact));
    const colours = lattices.map((lattice) => lattice.colour(element3D));
    const readings = [reading("in", input), ...colours.map((colour, t) =>
      reading(isPair ? tables[t].letter : "out", element("span", { id: `slice-out-${t}` }, triple(colour)), colour))];
    if (isPair) readings.push(reading("difference", element("span", { id: "slice-difference" }, brief(apart(...colours)))));
    clear(byId("slice-readout"), ...readings);
  }
}
