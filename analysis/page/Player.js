//<![CDATA[
// Plays source and result side by side. Lengths are millimeters of the result, y is up, the floor is y = 0.
"use strict";
(() => {
  const data = JSON.parse(document.getElementById("motion").textContent);
  const player = document.getElementById("player");
  const canvas = player.querySelector("canvas");
  const slider = player.querySelector("input");
  const playButton = player.querySelector(".play");
  const speed = player.querySelector("select");
  const views = { "front": [0, 8], "side": [90, 8], "three-quarter": [40, 14], "top": [0, 90] }; // degrees
  const lastFrame = data.frames - 1;
  let [yaw, pitch] = views["three-quarter"];
  let frame = 0;
  let playing = false;

  function figure(name) {
    const { points, step, bones, positions } = data[name];
    const steps = new Int16Array(Uint8Array.from(atob(positions), (c) => c.charCodeAt(0)).buffer);
    return { name, points, bones, steps, step, samples: steps.length / (3 * points) };
  }
  const figures = [figure("source"), figure("result")];

  // The points of a figure in a frame, between two samples if need be.
  function pose({ points, steps, step, samples }, frame) {
    const at = Math.min(frame / data.stride, samples - 1);
    const first = Math.floor(at), part = at - first;
    const a = first * points * 3, b = Math.min(first + 1, samples - 1) * points * 3;
    return Array.from({ length: points }, (_, i) => [0, 1, 2].map((axis) =>
      step * (steps[a + 3 * i + axis] * (1 - part) + steps[b + 3 * i + axis] * part)));
  }

  // How far all poses reach from their roots, and their height.
  const extent = { radius: 1, height: 1 };
  for (const shown of figures) {
    const stride = Math.max(1, Math.ceil(shown.samples / 500));
    for (let sample = 0; sample < shown.samples; sample += stride) {
      const points = pose(shown, sample * data.stride);
      for (const [x, y, z] of points) {
        extent.radius = Math.max(extent.radius, Math.hypot(x - points[0][0], z - points[0][2]));
        extent.height = Math.max(extent.height, y);
      }
    }
  }

  const color = (name) => getComputedStyle(player).getPropertyValue("--" + name).trim();
  const context = canvas.getContext("2d");

  // Returns a function from a point to its place in a panel and its depth, nearer being larger.
  function lens(panel, center) {
    const turn = yaw * Math.PI / 180, tilt = pitch * Math.PI / 180;
    const [ax, az] = data.across; // toward the body's left; it faces (-az, ax)
    const right = [ax * Math.cos(turn) - az * Math.sin(turn), az * Math.cos(turn) + ax * Math.sin(turn)];
    const toward = [-right[1], right[0]];
    const up = extent.height * Math.cos(tilt) + 2 * extent.radius * Math.sin(tilt) ** 2;
    const scale = Math.min(panel.width / (2.2 * extent.radius), (panel.height - 60) / (1.06 * up));
    const middle = extent.height / 2;
    return ([x, y, z]) => {
      const across = (x - center[0]) * right[0] + (z - center[2]) * right[1];
      const depth = (x - center[0]) * toward[0] + (z - center[2]) * toward[1];
      const height = (y - middle) * Math.cos(tilt) - depth * Math.sin(tilt);
      return { x: panel.left + panel.width / 2 + across * scale, y: panel.height / 2 + 12 - height * scale,
        depth: depth * Math.cos(tilt) + y * Math.sin(tilt) };
    };
  }

  function line(from, to, style, width) {
    context.strokeStyle = style;
    context.lineWidth = width;
    context.beginPath();
    context.moveTo(from.x, from.y);
    context.lineTo(to.x, to.y);
    context.stroke();
  }

  // A grid fixed to the floor, around the figure: it moves as the figure travels.
  function drawFloor(project, center) {
    const cell = 500, count = Math.max(3, Math.ceil(1.2 * extent.radius / cell));
    const x = Math.round(center[0] / cell) * cell, z = Math.round(center[2] / cell) * cell;
    const reach = count * cell;
    for (let i = -count; i <= count; ++i) {
      line(project([x + i * cell, 0, z - reach]), project([x + i * cell, 0, z + reach]), color("line"), 1);
      line(project([x - reach, 0, z + i * cell]), project([x + reach, 0, z + i * cell]), color("line"), 1);
    }
  }

  function drawFigure(shown, panel) {
    const points = pose(shown, frame);
    const center = points[0];
    const project = lens(panel, center);
    context.save();
    context.beginPath();
    context.rect(panel.left, 0, panel.width, panel.height);
    context.clip();
    context.lineCap = "round";
    drawFloor(project, center);
    const styles = [color("bone"), color("left"), color("right")];
    const shadow = color("shadow");
    const lines = shown.bones.map(([from, to, side]) => ({ from: points[from], to: points[to], side }));
    for (const bone of lines)
      line(project([bone.from[0], 0, bone.from[2]]), project([bone.to[0], 0, bone.to[2]]), shadow, 3);
    const drawn = lines.map((bone) => ({ a: project(bone.from), b: project(bone.to), side: bone.side }));
    drawn.sort((first, second) => first.a.depth + first.b.depth - second.a.depth - second.b.depth);
    for (const bone of drawn)
      line(bone.a, bone.b, styles[bone.side], 3.5);
    context.restore();
    const number = shown.name === "source" ? Math.round(frame) : Math.round(frame * data.frameScale);
    context.fillStyle = color(shown.name);
    context.fillText(shown.name, panel.left + 10, 20);
    context.fillStyle = color("soft");
    context.fillText("frame " + number, panel.left + 10, 38);
  }

  function draw() {
    const ratio = window.devicePixelRatio || 1;
    const width = canvas.clientWidth, height = canvas.clientHeight;
    if (canvas.width !== Math.round(width * ratio) || canvas.height !== Math.round(height * ratio)) {
      canvas.width = Math.round(width * ratio);
      canvas.height = Math.round(height * ratio);
    }
    context.setTransform(ratio, 0, 0, ratio, 0, 0);
    context.clearRect(0, 0, width, height);
    context.font = "13px " + getComputedStyle(player).fontFamily;
    figures.forEach((shown, i) => drawFigure(shown, { left: i * width / 2, width: width / 2, height }));
    slider.value = Math.round(frame);
  }

  function go(to) {
    frame = Math.min(Math.max(to, 0), lastFrame);
    draw();
  }

  let before;
  function tick(now) {
    if (!playing) return;
    const passed = before === undefined ? 0 : (now - before) / 1000;
    before = now;
    const next = frame + passed * Number(speed.value) / data.seconds;
    go(next > lastFrame ? 0 : next);
    requestAnimationFrame(tick);
  }
  function play(wanted) {
    playing = wanted;
    before = undefined;
    playButton.textContent = playing ? "Pause" : "Play";
    if (playing) requestAnimationFrame(tick);
  }

  // The bar: where feet are planted, and the worst frames.
  const share = (at) => 100 * at / Math.max(lastFrame, 1) + "%";
  const strips = player.querySelector(".strips");
  for (const foot of data.feet)
    for (const side of ["source", "result"]) {
      const row = strips.appendChild(document.createElement("div"));
      row.title = foot.name + " planted in the " + side;
      for (const [first, end] of foot[side]) {
        const part = row.appendChild(document.createElement("i"));
        part.className = side;
        part.style.left = share(first);
        part.style.width = share(Math.min(end, lastFrame) - first);
      }
    }
  player.querySelector(".feet").textContent = "(" + data.feet.map((foot) => foot.name).join(" above ") + ")";
  for (const [at, number] of data.marks) {
    const mark = player.querySelector(".marks").appendChild(document.createElement("button"));
    mark.type = "button";
    mark.className = "number";
    mark.textContent = number;
    mark.title = "Worst frame " + number + ": frame " + at;
    mark.style.left = share(at);
    mark.addEventListener("click", () => { play(false); go(at); });
  }

  for (const name of Object.keys(views)) {
    const button = player.querySelector(".views").appendChild(document.createElement("button"));
    button.type = "button";
    button.textContent = name;
    button.addEventListener("click", () => { [yaw, pitch] = views[name]; draw(); });
  }
  slider.max = lastFrame;
  slider.addEventListener("input", () => { play(false); go(Number(slider.value)); });
  playButton.addEventListener("click", () => play(!playing));
  canvas.addEventListener("keydown", (event) => {
    const steps = { ArrowLeft: -1, ArrowRight: 1 }[event.key];
    if (event.key === " ") play(!playing);
    else if (steps) { play(false); go(Math.round(frame) + steps); }
    else if (event.key === "Home") go(0);
    else if (event.key === "End") go(lastFrame);
    else return;
    event.preventDefault();
  });
  canvas.addEventListener("pointerdown", (event) => canvas.setPointerCapture(event.pointerId));
  canvas.addEventListener("pointermove", (event) => {
    if (!canvas.hasPointerCapture(event.pointerId)) return;
    yaw -= event.movementX / 2;
    pitch = Math.min(90, Math.max(0, pitch + event.movementY / 2));
    draw();
  });
  matchMedia("(prefers-color-scheme: dark)").addEventListener("change", draw);
  new ResizeObserver(draw).observe(canvas);
  // A link to a frame: page.html#frame=35
  const asked = /frame=([0-9]+)/.exec(location.hash);
  go(asked ? Number(asked[1]) : 0);
})();
//]]>
