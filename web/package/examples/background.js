// What lies behind a page gets no pointer events of its own.
const water = document.querySelector('tidemark-water');
addEventListener('pointerdown', ({ clientX, clientY }) => water.drop(clientX, clientY));
addEventListener('pointermove', ({ clientX, clientY }) => water.drop(clientX, clientY, { strength: 0.1 }));
