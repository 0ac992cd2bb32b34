// The lattice as a cloud: each point has its output colour and stands where that colour is, or, in
// the view beside it, where its input is. All views turn together.

const mostCloudPoints = 40000;
const mostCloudLines = 2200;

/** From colours to places in the unit cube, inputs and outputs alike where both fit into one. */
function cloudScale() {
  const { min, max } = data.grid;
  const width = Math.max(...max.map((value, c) => value - min[c])) || 1;
  const low = Math.min(...min);
  const extents = tables.map((table) => table.extent);
  const least = Math.min(low, ...extents.map((extent) => extent.min));
  const most = Math.max(low + width, ...extents.map((extent) => extent.max));
  if (most - least <= 2 * width) {
    const place = (colour) => colour.map((value) => (value - least) / (most - least || 1));
    return { input: place, output: place, isCommon: true };
  }
  const [from, to] = [Math.min(...extents.map((extent) => extent.min)), Math.max(...extents.map((extent) => extent.max))];
  return {
    input: (colour) => colour.map((value, c) => (value - min[c]) / (max[c] - min[c] || 1)),
    output: (colour) => colour.map((value) => (value - from) / (to - from || 1)),
    isCommon: false,
  };
}

/** The points of the lattice, every `stride`th along each axis and the last. */
function gridPoints(most) {
  let stride = 1;
  const along = (side) => {
    const indices = [];
    for (let i = 0; i < side - 1; i += stride) indices.push(i);
    return [...indices, side - 1];
  };
  while (data.grid.size.reduce((count, side) => count * along(side).length, 1) > most) ++stride;
  const [reds, greens, blues] = data.grid.size.map(along);
  return blues.flatMap((b) => greens.flatMap((g) => reds.map((r) => [r, g, b])));
}

function hasWebGL() {
  try {
    return document.createElement("canvas").getContext("webgl") !== null;
  } catch {
    return false;
  }
}

class CloudView {
  constructor() {
    if (!hasWebGL()) {
      byId("cloud-caption").textContent = "This browser draws no WebGL, which the turning cloud needs; the slices show the same points.";
      byId("cloud-choice").hidden = true;
      return;
    }
    this.scale = cloudScale();
    this.renderer = new THREE.WebGLRenderer({ antialias: true });
    this.camera = new THREE.PerspectiveCamera(35, 1, 0.1, 20);
    this.camera.position.set(1.9, 1.35, 2.6).add(new THREE.Vector3(0.5, 0.5, 0.5));
    this.views = [
      this.view("Input", null),
      ...tables.map((table, t) => this.view(isPair ? `${table.letter}: ${table.name}` : "Output", t)),
    ];
    const names = ["Points", "Lines from the input"];
    if (isPair) names.push(`Lines from ${tables[0].letter} to ${tables[1].letter}`);
    choices(byId("cloud-choice"), names, (index) => this.showLines(index));
    byId("cloud-caption").textContent =
      this.scale.isCommon ? "" : "Inputs and outputs have scales of their own.";
    byId("cloud-hint").textContent = "Drag to turn; after a click the wheel comes nearer. Arrow keys turn as well.";
    drawn(() => this.render());
  }

  view(name, t) {
    const canvas = element("canvas", { tabIndex: 0, role: "img", ariaLabel: `${name}: cloud of the lattice's points. Arrow keys turn it.` });
    const box = element("div", { className: "cloud" }, canvas);
    byId("cloud-views").append(element("figure", {}, box, element("figcaption", {}, name)));
    const scene = new THREE.Scene();
    scene.add(this.frame(), this.points(t));
    const lines = new THREE.Group();
    const mark = new THREE.Mesh(new THREE.SphereBufferGeometry(0.025, 16, 12), new THREE.MeshBasicMaterial({ color: 0xff00ff, depthTest: false }));
    Object.assign(mark, { visible: false, renderOrder: 1 });  // seen through the cloud
    scene.add(lines, mark);
    const controls = new THREE.OrbitControls(this.camera, canvas);
    Object.assign(controls, { enableKeys: false, enablePan: false, minDistance: 1.2, maxDistance: 8 });
    controls.target.set(0.5, 0.5, 0.5);
    // Deliberate: a wheel that only passes by scrolls the page.
    controls.enableZoom = false;
    canvas.addEventListener("focus", () => { controls.enableZoom = true; });
    canvas.addEventListener("blur", () => { controls.enableZoom = false; });
    controls.update();
    controls.addEventListener("change", () => this.render());
    canvas.addEventListener("keydown", (event) => this.turn(event));
    new ResizeObserver(() => this.render()).observe(box);
    return { t, box, canvas, scene, lines, mark };
  }

  /** Where a point of the lattice stands in a view: t is its table, null for the input. */
  place(t, [r, g, b]) {
    return t === null
      ? this.scale.input(gridColour(r, g, b))
      : this.scale.output(lattices[t].colour(lattices[t].element(r, g, b)));
  }

  /** Points have their output's colour; those of the input view that behind the first table. */
  points(t) {
    const places = [];
    const colours = [];
    for (const point of gridPoints(mostCloudPoints)) {
      const place = this.place(t, point);
      if (place.some(Number.isNaN)) continue;
      places.push(...place);
      const colour = lattices[t ?? 0].colour(lattices[0].element(...point));
      colours.push(...screenColour(colour).map((byte) => byte / 255));
    }
    const geometry = new THREE.BufferGeometry();
    geometry.setAttribute("position", new THREE.Float32BufferAttribute(places, 3));
    geometry.setAttribute("color", new THREE.Float32BufferAttribute(colours, 3));
    const size = 0.5 / Math.cbrt(Math.max(places.length / 3, 1));
    return new THREE.Points(geometry, new THREE.PointsMaterial({ size, vertexColors: THREE.VertexColors }));
  }

  /** The unit cube, its grey diagonal and letters at the ends of red, green and blue. */
  frame() {
    const group = new THREE.Group();
    this.frameMaterial = this.frameMaterial ?? new THREE.LineBasicMaterial();
    const cube = new THREE.LineSegments(new THREE.EdgesGeometry(new THREE.BoxBufferGeometry(1, 1, 1)), this.frameMaterial);
    cube.position.set(0.5, 0.5, 0.5);
    const diagonal = new THREE.BufferGeometry().setFromPoints([new THREE.Vector3(0, 0, 0), new THREE.Vector3(1, 1, 1)]);
    group.add(cube, new THREE.Line(diagonal, this.frameMaterial));
    ["R", "G", "B"].forEach((letter, axis) => {
      const canvas = element("canvas", { width: 64, height: 64 });
      const context = canvas.getContext("2d");
      Object.assign(context, { font: "bold 44px system-ui, sans-serif", textAlign: "center", textBaseline: "middle", fillStyle: ["#e0603a", "#1fa37c", "#5b86ee"][axis] });
      context.fillText(letter, 32, 34);
      const sprite = new THREE.Sprite(new THREE.SpriteMaterial({ map: new THREE.CanvasTexture(canvas) }));
      sprite.scale.setScalar(0.13);
      sprite.position.set(...[0, 1, 2].map((c) => (c === axis ? 1.09 : 0)));
      group.add(sprite);
    });
    return group;
  }

  showLines(kind) {
    for (const { t, lines } of this.views) {
      while (lines.children.length > 0) lines.remove(lines.children[0]);
      const from = kind === 1 ? null : 0;
      if (kind === 0 || t === null || t === from) continue;
      const places = [];
      const colours = [];
      for (const point of gridPoints(mostCloudLines)) {
        const [start, end] = [this.place(from, point), this.place(t, point)];
        if ([...start, ...end].some(Number.isNaN)) continue;
        places.push(...start, ...end);
        const colour = screenColour(lattices[t].colour(lattices[t].element(...point))).map((byte) => byte / 255);
        colours.push(...colour.map((value) => value * 0.35 + 0.3), ...colour);  // begins greyish
      }
      const geometry = new THREE.BufferGeometry();
      geometry.setAttribute("position", new THREE.Float32BufferAttribute(places, 3));
      geometry.setAttribute("color", new THREE.Float32BufferAttribute(colours, 3));
      lines.add(new THREE.LineSegments(geometry, new THREE.LineBasicMaterial({ vertexColors: THREE.VertexColors })));
    }
    this.views.forEach(({ t, scene, lines }) => {
      scene.children.filter((child) => child.isPoints).forEach((points) => {
        points.visible = kind === 0 || t === null || lines.children.length === 0;
      });
    });
    this.render();
  }

  turn(event) {
    const angles = { ArrowLeft: [-1, 0], ArrowRight: [1, 0], ArrowUp: [0, -1], ArrowDown: [0, 1] };
    const turn = angles[event.key];
    if (!turn) return;
    event.preventDefault();
    const centre = new THREE.Vector3(0.5, 0.5, 0.5);
    const place = new THREE.Spherical().setFromVector3(this.camera.position.clone().sub(centre));
    place.theta += turn[0] * 0.1;
    place.phi = Math.min(Math.max(place.phi + turn[1] * 0.1, 0.05), Math.PI - 0.05);
    this.camera.position.setFromSpherical(place).add(centre);
    this.camera.lookAt(centre);
    this.render();
  }

  /** Shows where a point of the lattice is. */
  mark(point) {
    if (!this.views) return;
    for (const { t, mark } of this.views) {
      const place = this.place(t, point);
      mark.visible = !place.some(Number.isNaN);
      if (mark.visible) mark.position.set(...place);
    }
    this.render();
  }

  /** One renderer for all views; what it drew is copied, as browsers do not print WebGL. */
  render() {
    const { renderer, camera } = this;
    this.frameMaterial.color.set(theme().quiet);
    renderer.setClearColor(theme().space);
    renderer.setPixelRatio(Math.min(devicePixelRatio, 2));
    for (const { box, canvas, scene } of this.views ?? []) {
      const [width, height] = [box.clientWidth, Math.max(box.clientHeight, 1)];
      camera.aspect = width / height;
      camera.updateProjectionMatrix();
      renderer.setSize(width, height, false);
      renderer.render(scene, camera);
      const drawing = renderer.domElement;
      Object.assign(canvas, { width: drawing.width, height: drawing.height });
      canvas.getContext("2d").drawImage(drawing, 0, 0);
    }
  }
}
