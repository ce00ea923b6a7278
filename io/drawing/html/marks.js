// Single marks on a canvas; places and sizes are in pixels.

/** Adds two crossed strokes to the path, from the middle `reach` to each side. */
export function cross(context, [x, y], reach) {
  context.moveTo(x - reach, y - reach);
  context.lineTo(x + reach, y + reach);
  context.moveTo(x + reach, y - reach);
  context.lineTo(x - reach, y + reach);
}

export function ring(context, [x, y], radius, color) {
  context.strokeStyle = color;
  context.lineWidth = 2;
  context.beginPath();
  context.arc(x, y, radius, 0, 2 * Math.PI);
  context.stroke();
}

export function square(context, colors, [x, y], size) {
  context.fillStyle = colors.paper;
  context.strokeStyle = colors.text;
  context.lineWidth = 1.2;
  context.fillRect(x - 0.5 * size, y - 0.5 * size, size, size);
  context.strokeRect(x - 0.5 * size, y - 0.5 * size, size, size);
}

/** A triangle that starts at (x, y) and points along (dx, dy). */
export function arrow(context, colors, [x, y], [dx, dy], size, isOutlined) {
  const length = Math.hypot(dx, dy);
  if (!(length > 0)) return;
  const ux = size * dx / length, uy = size * dy / length;
  context.beginPath();
  context.moveTo(x + ux, y + uy);
  context.lineTo(x - 0.5 * uy, y + 0.5 * ux);
  context.lineTo(x + 0.5 * uy, y - 0.5 * ux);
  context.closePath();
  context.fillStyle = colors.start;
  context.fill();
  if (!isOutlined) return;
  context.strokeStyle = colors.text;
  context.lineWidth = 1.1;
  context.stroke();
}
