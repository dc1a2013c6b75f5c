// Buttons and sliders that show a setting and change it.
export function make<Tag extends keyof HTMLElementTagNameMap>(
    tag: Tag, properties: Partial<HTMLElementTagNameMap[Tag]> = {}, ...children: (Node | string)[]
): HTMLElementTagNameMap[Tag] {
    const element = Object.assign(document.createElement(tag), properties);
    element.append(...children);
    return element;
}

// The word for a value. Each word names an equal part of the range.
export const wordOf = (value: number, min: number, max: number, words: readonly string[]): string =>
    words[Math.min(words.length - 1, Math.floor((words.length * (value - min)) / (max - min)))]!;

export interface Slider {
    title: string;
    min: number;
    max: number;
    step: number;
    help?: string;
    get(): number;
    set(value: number): void;
    word(value: number): string;
}

// Calls `changed` after each change.
export function makeControls(changed: () => void) {
    const refreshers: (() => void)[] = [];
    let sliders = 0;
    return {
        /** Adds a function that shows the current settings. */
        follow: (refresh: () => void): void => void refreshers.push(refresh),
        refresh: (): void => refreshers.forEach((refresh) => refresh()),

        section: (title: string, ...children: (Node | string)[]): HTMLElement =>
            make('fieldset', {}, make('legend', {}, title), ...children),

        /** A section whose title names the chosen button. */
        choices(title: string, chosen: () => string, ...children: (Node | string)[]): HTMLElement {
            const name = make('output');
            this.follow(() => (name.textContent = chosen()));
            return make('fieldset', {}, make('legend', {}, `${title} `, name), ...children);
        },

        choice(name: string, chosen: () => boolean, choose: () => void, ...children: (Node | string)[]): HTMLButtonElement {
            const button = make('button', { type: 'button', ariaLabel: name || null, onclick: () => (choose(), changed()) }, ...children);
            this.follow(() => (button.ariaPressed = String(chosen())));
            return button;
        },

        slider({ title, min, max, step, help, get, set, word }: Slider): HTMLElement {
            const id = `slider-${++sliders}`;
            const input = make('input', {
                type: 'range', id, min: String(min), max: String(max), step: String(step),
                oninput: () => (set(Number(input.value)), changed()),
            });
            const output = make('output', { htmlFor: id } as object);
            this.follow(() => {
                input.value = String(get());
                input.ariaValueText = output.textContent = word(get());
            });
            const label = make('label', { htmlFor: id }, title);
            const row = make('div', { className: 'slider' }, label, input, output);
            if (help) {
                row.append(make('small', { id: `${id}-help` }, help));
                input.setAttribute('aria-describedby', `${id}-help`);
            }
            return row;
        },
    };
}

export type Controls = ReturnType<typeof makeControls>;
