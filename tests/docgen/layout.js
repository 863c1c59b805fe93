// What must hold of the layout. Each complaint names the expression by the text of its block.
const complaints = [];
function box(node) { return node.getBoundingClientRect(); }
function expect(holds, what, node) {
  if (!holds) complaints.push(what + ' in "' + node.closest('math').textContent + '"');
}
const blocks = document.querySelectorAll('math');
for (const math of blocks) {
  const own = box(math);
  expect(math.textContent.trim() !== '' && own.width > 0 && own.height > 0, 'nothing shown', math);
  expect(own.left - box(math.parentElement).left < 5, 'not at the left', math);
}
const fences = document.querySelectorAll('mfenced');
for (const fence of fences) {
  const own = box(fence);
  const style = getComputedStyle(fence);
  const brace = fence.getAttribute('open') === '{';
  expect(own.width > 0 && own.height > 0, 'no fence', fence);
  expect(parseFloat(style.borderLeftWidth) >= (brace ? 5 : 0.5), 'no opening fence', fence);
  expect(brace || parseFloat(style.borderRightWidth) >= 0.5, 'no closing fence', fence);
  for (const part of fence.children) {
    const inner = box(part);
    expect(inner.left - own.left >= 2 && (brace || own.right - inner.right >= 2), 'a narrow fence', fence);
    expect(own.top <= inner.top + 1 && own.bottom >= inner.bottom - 1, 'a low fence', fence);
  }
}
const operands = 'mi, mn, mrow, mfrac, mfenced, mtext';
function gap(left, right) { return box(right).left - box(left).right; }
for (const argument of document.querySelectorAll('mfenced:not([separators]) > mrow:not(:last-child)')) {
  const room = box(argument).right - box(argument.lastElementChild).right;
  expect(room >= 6 && getComputedStyle(argument).backgroundImage !== 'none', 'no comma', argument);
}
for (const row of document.querySelectorAll('math > mrow, mtd, mfenced[separators]')) {
  for (const part of row.children) {
    const next = part.nextElementSibling;
    if (!next || !part.matches(operands) || !next.matches('mi, mn, mfrac')) continue;
    expect(gap(part, next) >= 3, 'members of an interaction run together', part);
  }
}
for (const sign of document.querySelectorAll('mi + mtext[mathcolor=green]')) {
  expect(gap(sign.previousElementSibling, sign) >= 2, 'a modification sticks to its target', sign);
}
for (const letter of document.querySelectorAll('mfrac mi, mfrac mn')) {
  const whole = parseFloat(getComputedStyle(letter.closest('math')).fontSize);
  expect(parseFloat(getComputedStyle(letter).fontSize) >= 0.49 * whole, 'too small', letter);
}
const report = document.createElement('pre');
report.id = 'report';
report.textContent = 'blocks ' + blocks.length + ' fences ' + fences.length + ' complaints ' +
  complaints.length + '\n' + complaints.slice(0, 200).join('\n') + '\nend of report';
document.body.append(report);
