// A picture before and after, divided by the slider.

function showPicture() {
  const { picture } = data;
  byId("picture-caption").textContent = `${picture.caption} Left of the line before, right of it after.`;
  const splits = tables.map((table, t) => {
    const split = element("div", { className: "split" },
      element("img", { src: picture.before, alt: `${picture.name}, before` }),
      element("img", { src: picture.after[t], alt: `${picture.name}, after ${table.name}` }));
    byId("picture-views").append(element("figure", {}, split, element("figcaption", {}, isPair ? `${table.letter}: ${table.name}` : picture.name)));
    return split;
  });
  const slider = byId("picture-split");
  const move = (percent) => {
    slider.value = String(percent);
    splits.forEach((split) => split.style.setProperty("--split", `${slider.value}%`));
  };
  slider.addEventListener("input", () => move(slider.value));
  for (const split of splits) {
    const follow = (event) => {
      if (event.buttons === 0 && event.type === "pointermove") return;
      const box = split.getBoundingClientRect();
      move(((event.clientX - box.left) / box.width) * 100);
    };
    split.addEventListener("pointerdown", follow);
    split.addEventListener("pointermove", follow);
    split.addEventListener("dragstart", (event) => event.preventDefault());
  }
  move(50);
}
