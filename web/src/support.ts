// What the page says where it cannot work.
const message = document.querySelector<HTMLElement>('#message')!;

export function say(text: string): void {
    message.textContent = text;
    message.hidden = text === '';
}

// The smallest module with a vector in it: a function that makes one and drops it.
const vectors = new Uint8Array([
    0, 97, 115, 109, 1, 0, 0, 0, 1, 4, 1, 96, 0, 0, 3, 2, 1, 0, 10, 9, 1, 7, 0, 65, 0, 253, 15, 26, 11,
]);

export function hasVectors(): boolean {
    return typeof WebAssembly === 'object' && WebAssembly.validate(vectors);
}
