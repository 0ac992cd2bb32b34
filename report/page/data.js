// The numbers of the page: what the program embedded, and how they are written.

const data = JSON.parse(document.getElementById("data").textContent);
const tables = data.tables;
const isPair = tables.length === 2;
const channelNames = ["red", "green", "blue"];

function bytesOf(base64) {
  return Uint8Array.from(atob(base64), (character) => character.charCodeAt(0));
}

/** Little-endian floats; NaN and infinities are themselves. */
function floatsOf(base64) {
  return new Float32Array(bytesOf(base64).buffer);
}

/** A lattice of 16-bit codes: the colour of a point, NaN for what is no number. Red runs fastest. */
class Lattice {
  constructor(grid, codes, extent) {
    this.size = grid.size;
    this.codes = new Uint16Array(bytesOf(codes).buffer);
    this.extent = extent;
  }

  get pointCount() {
    return this.codes.length / 3;
  }

  element(r, g, b) {
    return (b * this.size[1] + g) * this.size[0] + r;
  }

  value(element, channel) {
    const code = this.codes[3 * element + channel];
    const { min, max } = this.extent;
    return code === 65535 ? NaN : min + (code / 65534) * (max - min);
  }

  colour(element) {
    return [0, 1, 2].map((channel) => this.value(element, channel));
  }
}

/** A number with the digits that give the same single-precision number again, as `eval` prints. */
function exact(value) {
  if (!Number.isFinite(value)) return Number.isNaN(value) ? "nan" : value > 0 ? "inf" : "-inf";
  for (let digits = 1; digits < 10; ++digits) {
    const text = value.toPrecision(digits);
    if (Math.fround(Number(text)) === Math.fround(value)) return String(Number(text));
  }
  return String(value);
}

/** A number for reading: as many digits as a picture has. */
function brief(value, digits = 4) {
  if (typeof value === "string" || !Number.isFinite(value)) return String(value).replace("NaN", "nan");
  const size = Math.abs(value);
  return size !== 0 && (size < 1e-4 || size >= 1e5) ? value.toExponential(2) : String(Number(value.toFixed(digits)));
}

function triple(colour, write = brief) {
  return Array.from(colour, (value) => write(value)).join("\u2002");
}

/** An output as a colour of the screen. */
function screenColour(colour) {
  return colour.map((value) => (Number.isFinite(value) ? Math.round(Math.min(Math.max(value, 0), 1) * 255) : 0));
}

function cssColour(colour) {
  return `rgb(${screenColour(colour).join(" ")})`;
}

/** The place of the number in a rising list that is nearest to a value. */
function nearestIndex(list, value) {
  let low = 0;
  let high = list.length - 1;
  while (high - low > 1) {
    const middle = (low + high) >> 1;
    if (list[middle] < value) low = middle;
    else high = middle;
  }
  return value - list[low] <= list[high] - value ? low : high;
}
