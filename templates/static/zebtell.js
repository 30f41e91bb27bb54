// Comforts for the keyboard. Every page works without them.
'use strict';

const boxes = [...document.querySelectorAll('input.kogus[form="lisa"]')];

function go(box) {
  box.focus();
  box.select();
}

// Quantities go from row to row: Enter, Tab and the arrows pass over the links between the boxes.
// Backwards, Tab takes the links too.
function step(event) {
  if (event.altKey || event.ctrlKey || event.metaKey || event.isComposing) return;
  const at = boxes.indexOf(event.target);
  const back = event.key === 'ArrowUp' || (event.key === 'Enter' && event.shiftKey);
  const on = ['ArrowDown', 'Enter'].includes(event.key) || (event.key === 'Tab' && !event.shiftKey);
  const next = back ? boxes[at - 1] : on ? boxes[at + 1] : undefined;
  if (next) {
    event.preventDefault();
    go(next);
  } else if (event.key === 'Enter' && !back) {
    // Behind the last one stands the button that adds them all.
    event.preventDefault();
    document.querySelector('button[form="lisa"]').focus();
  }
}

for (const box of boxes) {
  box.enterKeyHint = 'next';
  box.addEventListener('keydown', step);
}

// From the search straight into the list.
const search = document.getElementById('tekst');
search?.addEventListener('keydown', (event) => {
  if (event.key !== 'ArrowDown' || !boxes[0]) return;
  event.preventDefault();
  go(boxes[0]);
});

// Rows pasted from a spreadsheet into a box for one code belong into the field for many.
const table = document.getElementById('tabel');
for (const box of document.querySelectorAll('input[name^="Code_f"]')) {
  box.addEventListener('paste', (event) => {
    const text = event.clipboardData.getData('text').trim();
    if (!table || !/[\t\n]/.test(text)) return;
    event.preventDefault();
    table.value = (table.value.trim() + '\n' + text).trim() + '\n';
    table.focus();
  });
}

for (const button of document.querySelectorAll('.trykk')) {
  button.hidden = false;
  button.addEventListener('click', () => window.print());
}
