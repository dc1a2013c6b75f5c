import { createWater } from 'tidemark-water/core';

// The picture under the water is a canvas that changes.
const source = document.createElement('canvas');
source.width = 1200;
source.height = 600;
const context = source.getContext('2d');

function draw(milliseconds) {
    const [width, height] = [source.width, source.height];
    context.fillStyle = '#0d3d4f';
    context.fillRect(0, 0, width, height);
    context.font = '90px Georgia, serif';
    for (let line = 0; line < 6; ++line) {
        context.fillStyle = `hsl(${170 + 12 * line} 60% ${40 + 6 * line}%)`;
        const shift = ((line % 2 ? 1 : -1) * milliseconds) / 30 % 700;
        context.fillText('still waters run deep · '.repeat(4), shift - 700, 100 * line + 80);
    }
    requestAnimationFrame(draw);
}

draw(0);
createWater(document.querySelector('canvas'), { src: source, interaction: 'hover press', ink: true, inkColor: '#99080d', firstDrop: true });
