// The settings as code, for web pages and for the hosts in Java and C++.
import { defaultLook, lookKeys, lookOf, type Choices } from 'tidemark-water';
import { addressOf, withPreset, type Settings } from './settings';

const pictureOf = ({ picture }: Settings) => addressOf(picture) ?? 'picture.jpg';

// The preset, and the options that differ from it.
function choices({ preset, ink, inkColor, rain, look }: Settings): Choices & { ink?: boolean } {
    const usual = withPreset(preset);
    return {
        preset,
        ...(ink !== usual.ink && { ink }),
        ...(ink && inkColor !== usual.inkColor && { inkColor }),
        ...(rain !== usual.rain && { rain }),
        ...(Object.keys(look).length > 0 && { look }),
    };
}

export function toHtml(settings: Settings): string {
    const words = Object.entries(choices(settings)).map(([name, value]) => {
        const attribute = name.replace('C', '-c');
        if (value === true) return ` ${attribute}`;
        if (value === false) return ` ${attribute}="off"`;
        return typeof value === 'object' ? ` ${attribute}='${JSON.stringify(value)}'` : ` ${attribute}="${value}"`;
    });
    return `<script type="module" src="tidemark-water.js"></script>\n<tidemark-water src="${pictureOf(settings)}"${words.join('')}></tidemark-water>\n`;
}

function toJavaScript(settings: Settings): string {
    const options = { src: pictureOf(settings), ...choices(settings) };
    return `import { createWater } from 'tidemark-water';\ncreateWater(document.querySelector('canvas'), ${JSON.stringify(options, null, 4)});\n`;
}

// Statements for a `water` that is an Android view or a host in C++.
function statements(settings: Settings): string {
    const usual = defaultLook();
    const look = lookOf(choices(settings));
    const assignments = lookKeys.filter(({ name }) => look[name] !== usual[name]).map(({ name, whole }) => {
        const text = String(Number(look[name]!.toFixed(4)));
        return `look.${name} = ${whole ? text : `${text.includes('.') ? text : `${text}.0`}f`};\n`;
    });
    return `${assignments.join('')}water.setLook(look);\nwater.setInk(${settings.ink});\nwater.setRain(${settings.rain > 0});\n`;
}

export const codes: Readonly<Record<string, (settings: Settings) => string>> = {
    JavaScript: toJavaScript,
    Java: (settings) => `Look look = new Look();\n${statements(settings)}`,
    'C++': (settings) => `tidemark::Look look;\n${statements(settings)}`,
};
