// The curves: outputs along the neutral axis or one channel's own, their slopes, and what they are
// at the place of the pointer.

const curves = data.curves.map((curve) => ({
  ...curve,
  inputs: floatsOf(curve.inputs),
  tables: curve.tables.map((each) => ({ outputs: floatsOf(each.outputs), slopes: floatsOf(each.slopes) })),
}));

/** The mark of a line. Equal lines lie on each other: each lets those below it show. */
function lineStyle(t, c) {
  const { channels, pales } = theme();
  if (!isPair) {
    return {
      borderColor: channels[c],
      borderWidth: [4, 4, 3.5][c],
      borderDash: [[], [16, 16], [6, 10]][c],
      borderDashOffset: [0, 0, -5][c],  // a dot in each dash of green, and one in each gap
    };
  }
  if (t === 0) return { borderColor: pales[c], borderWidth: [7, 4, 2][c] };
  return { borderColor: channels[c], borderWidth: 2, borderDash: [6, 9], borderDashOffset: -5 * c };
}

/** A step of 1, 2 or 5 in some decimal place, with which about four fill a distance. */
function roundStep(distance) {
  const power = 10 ** Math.floor(Math.log10(distance / 4));
  return [1, 2, 5, 10].find((factor) => factor * power >= distance / 4) * power;
}

class CurveView {
  constructor() {
    this.curve = curves[0];
    this.index = nearestIndex(this.curve.inputs, 0.18);
    this.values = this.chart("curve-chart", "output");
    this.slopes = this.chart("slope-chart", "slope");
    this.choose = choices(byId("curve-choice"), curves.map((curve) => curve.name), (index) => {
      const input = this.curve.inputs[this.index];
      this.curve = curves[index];
      this.index = nearestIndex(this.curve.inputs, input);
      this.show();
    });
    this.listen(byId("curve-chart"));
    this.listen(byId("slope-chart"));
    drawn(() => this.show());
  }

  inputColour(index) {
    const { channel, base, inputs } = this.curve;
    return base.map((value, c) => (channel < 0 || channel === c ? inputs[index] : value));
  }

  output(table, index) {
    return this.curve.tables[table].outputs.subarray(3 * index, 3 * index + 3);
  }

  /** Moves to the sample of an input. */
  goTo(input) {
    this.index = nearestIndex(this.curve.inputs, input);
    this.showPlace();
  }

  listen(canvas) {
    onPointer(canvas, (event) => {
      this.goTo(this.values.scales.x.getValueForPixel(event.offsetX));
    });
    canvas.addEventListener("keydown", (event) => {
      const last = this.curve.inputs.length - 1;
      const step = event.shiftKey ? Math.max(1, Math.round(last / 32)) : 1;
      const places = { ArrowLeft: this.index - step, ArrowRight: this.index + step, Home: 0, End: last };
      if (!(event.key in places)) return;
      event.preventDefault();
      this.index = Math.min(Math.max(places[event.key], 0), last);
      this.showPlace();
    });
  }

  chart(id, title) {
    return new Chart(byId(id), {
      type: "line",
      data: { datasets: [] },
      options: {
        animation: false,
        parsing: false,
        normalized: true,
        maintainAspectRatio: false,
        events: [],
        elements: { point: { radius: 0 } },
        scales: { x: { type: "linear" }, y: { title: { display: true, text: title } } },
        plugins: {
          legend: { display: false },
          tooltip: { enabled: false },
          decimation: { enabled: true, algorithm: "min-max", threshold: 3000 },
        },
      },
      plugins: [
        { id: "place", afterDatasetsDraw: (chart) => this.drawPlace(chart) },
        { id: "letters", afterDatasetsDraw: (chart) => this.drawLetters(chart) },
      ],
    });
  }

  /** All of the chosen curve, in the colours of now. */
  show() {
    const { inputs, channel } = this.curve;
    byId("curve-caption").textContent =
      (channel < 0 ? "Red, green and blue rise together." : `${this.curve.name}: the others stay at ${triple(this.curve.base.filter((_, c) => c !== channel))}.`) +
      (isPair ? " Pale lines: A; broken lines: B." : " Red is a full line, green broken, blue dotted.") +
      " Grey: what would not be changed.";
    const points = (values, c) => Array.from(inputs, (x, i) => {
      const y = values[3 * i + c];
      return { x, y: Number.isFinite(y) ? y : NaN };
    });
    const lines = (key) => this.curve.tables.flatMap((table, t) =>
      channelNames.map((name, c) => ({
        label: name,
        data: points(table[key], c),
        clip: 4,  // a line along the edge is drawn in its whole width
        order: -(3 * t + c),
        ...lineStyle(t, c),
      })));
    const ends = [inputs[0], inputs[inputs.length - 1]];
    const identity = (ys) => ({
      label: "identity",
      data: ends.map((x, i) => ({ x, y: ys[i] })),
      borderColor: theme().identity,
      borderWidth: 1,
      order: 1,
    });
    this.update(this.values, [...lines("outputs"), identity(ends)], ends, {});
    const { min, max, step } = this.slopeRange();
    Object.assign(this.slopes.options.scales.y, { min, max });
    this.update(this.slopes, [...lines("slopes"), identity([1, 1])], ends, { stepSize: step });
    this.showValues();
    this.showPlace();
  }

  /** The slope's axis, from tick to tick: a steep begin, as of a power function, would flatten all the rest. */
  slopeRange() {
    const all = this.curve.tables.flatMap((table) => Array.from(table.slopes).filter(Number.isFinite)).sort((a, b) => a - b);
    const usual = Math.max(2, 1.25 * (all[Math.floor(0.98 * (all.length - 1))] ?? 0));
    const greatest = all[all.length - 1] ?? 0;
    const most = greatest <= 2 * usual ? Math.max(usual, greatest) : usual;
    const least = Math.max(all[0] ?? 0, -most);
    const step = roundStep(most - Math.min(least, 0));
    const isFalling = least < -0.02 * most;  // less is rounding
    return { min: isFalling ? step * Math.floor(least / step) : 0, max: step * Math.ceil(most / step), step };
  }

  update(chart, datasets, [min, max], yTicks) {
    const { ink, quiet, rule } = theme();
    chart.data.datasets = datasets;
    Object.assign(chart.options.scales.x, { min, max, ticks: { color: quiet }, grid: { color: rule } });
    Object.assign(chart.options.scales.y, {
      ticks: { color: quiet, ...yTicks },
      grid: { color: rule },
      afterFit: (scale) => { scale.width = 58; },  // so that both charts begin at one line
    });
    chart.options.scales.y.title.color = ink;
    chart.update("none");
    chart.resize();
  }

  drawPlace(chart) {
    const { x, y } = chart.scales;
    const place = x.getPixelForValue(this.curve.inputs[this.index]);
    const { ctx, chartArea } = chart;
    ctx.save();
    ctx.strokeStyle = theme().ink;
    ctx.beginPath();
    ctx.moveTo(place, chartArea.top);
    ctx.lineTo(place, chartArea.bottom);
    ctx.stroke();
    const key = chart === this.values ? "outputs" : "slopes";
    this.curve.tables.forEach((table) => channelNames.forEach((_, c) => {
      const value = table[key][3 * this.index + c];
      if (!Number.isFinite(value)) return;
      ctx.fillStyle = theme().channels[c];
      ctx.beginPath();
      ctx.arc(place, y.getPixelForValue(value), 4, 0, 7);
      ctx.fill();
      ctx.stroke();
    }));
    ctx.restore();
  }

  /** Each line says by a letter which it is. */
  drawLetters(chart) {
    if (chart !== this.values) return;
    const { ctx, scales } = chart;
    ctx.save();
    ctx.font = "bold 13px system-ui, sans-serif";
    ctx.textAlign = "center";
    ctx.textBaseline = "middle";
    tables.forEach((_, t) => channelNames.forEach((name, c) => {
      const index = Math.round((0.62 - 0.36 * t + 0.12 * c) * (this.curve.inputs.length - 1));
      const value = this.output(t, index)[c];
      if (!Number.isFinite(value)) return;
      const [x, y] = [scales.x.getPixelForValue(this.curve.inputs[index]), scales.y.getPixelForValue(value)];
      ctx.fillStyle = theme().card;
      ctx.beginPath();
      ctx.arc(x, y, 9, 0, 7);
      ctx.fill();
      ctx.fillStyle = theme().channels[c];
      ctx.fillText(name[0].toUpperCase(), x, y + 1);
    }));
    ctx.restore();
  }

  showPlace() {
    this.values.draw();
    this.slopes.draw();
    const input = element("span", { id: "curve-in" }, triple(this.inputColour(this.index), exact));
    const readings = this.curve.tables.flatMap((table, t) => {
      const output = this.output(t, this.index);
      return [
        reading(isPair ? tables[t].letter : "out", element("span", { id: `curve-out-${t}` }, triple(output, exact)), output),
        reading("slope", triple(table.slopes.subarray(3 * this.index, 3 * this.index + 3))),
      ];
    });
    clear(byId("curve-readout"), reading("in", input), ...readings);
  }

  /** Some values in full, for paper and for who has no pointer. */
  showValues() {
    const { inputs } = this.curve;
    const [first, last] = [inputs[0], inputs[inputs.length - 1]];
    const places = Array.from({ length: 9 }, (_, i) => nearestIndex(inputs, first + ((last - first) * i) / 8));
    const grey = nearestIndex(inputs, 0.18);
    if (Math.abs(inputs[grey] - 0.18) < 1e-6) places.push(grey);
    const sorted = [...new Set(places)].sort((a, b) => a - b);
    clear(byId("curve-values"), ...tables.map((table, t) => tableOf(
      [isPair ? `${table.letter}: input` : "input", ...channelNames],
      sorted.map((index) => [brief(inputs[index]), ...Array.from(this.output(t, index), (value) => brief(value))]),
    )));
  }
}
