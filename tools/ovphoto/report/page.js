"use strict";
// The photometric solid, turned by dragging, by the arrow keys or by the buttons. Without this script its picture
// stands still.
(() => {
  const figure = document.getElementById("solid");
  const mesh = JSON.parse(document.getElementById("mesh").textContent);
  const picture = figure.querySelector("svg");
  const canvas = document.createElement("canvas");
  canvas.width = canvas.height = 900;
  canvas.tabIndex = 0;
  canvas.setAttribute("role", "img");
  const pen = canvas.getContext("2d");
  if (!pen || mesh.gammas.length < 2) return;
  const dark = matchMedia("(prefers-color-scheme: dark)");
  let turn = -45, tilt = 35.3;

  const radians = degrees => degrees * Math.PI / 180;
  const radius = (plane, i) => mesh.radii[(plane % mesh.planes) * mesh.gammas.length + i] / 1000;
  const place = (gamma, c, r) => {
    const across = r * Math.sin(radians(gamma));
    return [across * Math.cos(radians(c)), across * Math.sin(radians(c)), -r * Math.cos(radians(gamma))];
  };
  const faces = [];
  const step = 360 / mesh.planes;
  for (let plane = 0; plane < mesh.planes; ++plane)
    for (let i = 0; i + 1 < mesh.gammas.length; ++i)
      faces.push([[0, 0], [1, 0], [1, 1], [0, 1]].map(([dp, di]) =>
        place(mesh.gammas[i + di], (plane + dp) * step, radius(plane + dp, i + di))));
  const axes = mesh.axes.map(([name, gamma, c, from]) => ({name, gamma, c, from, to: Math.max(0.55, from + 0.15)}));
  // The solid turns around the middle of its box, and its farthest point stays in the picture.
  const points = faces.flat().concat(axes.map(axis => place(axis.gamma, axis.c, axis.to)));
  const [middle, extent] = (() => {
    const box = [0, 1, 2].map(k => points.reduce(([low, high], p) => [Math.min(low, p[k]), Math.max(high, p[k])],
                                                 [0, 0]));
    const centre = box.map(([low, high]) => (low + high) / 2);
    return [centre, points.reduce((most, p) => Math.max(most, Math.hypot(...p.map((x, k) => x - centre[k]))), 0)];
  })();

  function draw() {
    const [st, ct, se, ce] = [Math.sin(radians(turn)), Math.cos(radians(turn)), Math.sin(radians(tilt)),
                              Math.cos(radians(tilt))];
    const scale = 410 / extent;
    const flat = p => [p[1] * ct - p[0] * st, se * (p[0] * ct + p[1] * st) - ce * p[2]];
    const origin = flat(middle);
    const paper = p => flat(p).map((x, k) => 450 + scale * (x - origin[k]));
    const near = p => ce * (p[0] * ct + p[1] * st) + se * p[2];
    const ink = dark.matches ? "#b4b8be" : "#565656";
    const pieces = [];
    for (const face of faces) {
      const q = face.map(paper);
      const area = (q[2][0] - q[0][0]) * (q[3][1] - q[1][1]) - (q[2][1] - q[0][1]) * (q[3][0] - q[1][0]);
      if (area > -1e-3) continue;
      const a = [0, 1, 2].map(k => face[2][k] - face[0][k]), b = [0, 1, 2].map(k => face[3][k] - face[1][k]);
      const n = [a[1] * b[2] - a[2] * b[1], a[2] * b[0] - a[0] * b[2], a[0] * b[1] - a[1] * b[0]];
      // Lit from the viewer's upper left.
      const towards = near(n), right = n[1] * ct - n[0] * st, up = ce * n[2] - se * (n[0] * ct + n[1] * st);
      const light = (0.7 * towards - 0.35 * right + 0.5 * up) / (Math.hypot(...n) || 1);
      pieces.push({near: face.reduce((sum, p) => sum + near(p) / 4, 0), q, light});
    }
    for (const axis of axes)
      for (let k = 0; k < 24; ++k) {
        const at = i => place(axis.gamma, axis.c, axis.from + (axis.to - axis.from) * i / 24);
        pieces.push({near: near(at(k)), q: [paper(at(k)), paper(at(k + 1))]});
      }
    pieces.sort((x, y) => x.near - y.near);
    pen.clearRect(0, 0, 900, 900);
    pen.lineJoin = "round";
    for (const piece of pieces) {
      pen.beginPath();
      for (const [x, y] of piece.q) pen.lineTo(x, y);
      if (piece.q.length > 2) {
        const l = Math.round(34 + 34 * Math.max(0, piece.light));
        pen.closePath();
        pen.fillStyle = `hsl(202 80% ${l}%)`;
        pen.strokeStyle = `hsl(202 80% ${l - 9}%)`;
        pen.lineWidth = 1;
        pen.fill();
      } else {
        pen.strokeStyle = ink;
        pen.lineWidth = 2;
      }
      pen.stroke();
    }
    pen.fillStyle = ink;
    pen.font = "22px system-ui, sans-serif";
    pen.textAlign = "center";
    pen.textBaseline = "middle";
    pen.lineWidth = 6;
    pen.strokeStyle = dark.matches ? "#000" : "#fff";
    for (const axis of axes) {
      const at = paper(place(axis.gamma, axis.c, axis.to + 0.06));
      pen.strokeText(axis.name, ...at);
      pen.fillText(axis.name, ...at);
    }
    canvas.setAttribute("aria-label", `Photometric solid, turned by ${Math.round(((turn % 360) + 360) % 360)}` +
      ` degrees, seen from ${Math.round(tilt)} degrees above; arrow keys turn it`);
  }

  function move(byTurn, byTilt) {
    turn += byTurn;
    tilt = Math.max(-90, Math.min(90, tilt + byTilt));
    draw();
  }

  const keys = {ArrowLeft: [-10, 0], ArrowRight: [10, 0], ArrowUp: [0, 10], ArrowDown: [0, -10]};
  canvas.addEventListener("keydown", event => {
    if (!keys[event.key]) return;
    move(...keys[event.key]);
    event.preventDefault();
  });
  canvas.addEventListener("pointerdown", event => canvas.setPointerCapture(event.pointerId));
  canvas.addEventListener("pointermove", event => {
    if (canvas.hasPointerCapture(event.pointerId)) move(-event.movementX / 2, event.movementY / 2);
  });
  const buttons = document.createElement("div");
  buttons.className = "turn";
  for (const [text, by] of [["Turn left", keys.ArrowLeft], ["Turn right", keys.ArrowRight],
                            ["Tilt up", keys.ArrowUp], ["Tilt down", keys.ArrowDown]]) {
    const button = document.createElement("button");
    button.type = "button";
    button.textContent = text;
    button.addEventListener("click", () => move(...by));
    buttons.append(button);
  }
  picture.replaceWith(canvas, buttons);
  dark.addEventListener("change", draw);
  // On paper the picture is sharper, and not dark.
  addEventListener("beforeprint", () => canvas.replaceWith(picture));
  addEventListener("afterprint", () => picture.replaceWith(canvas));
  draw();
})();
