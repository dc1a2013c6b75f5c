// The chosen values in the words of the two reference hosts.
import { chosenKeys, lookKeys } from './look';
import type { Settings } from './settings';

const chosen = new Set(chosenKeys.map(({ name }) => name));

function assignments({ look }: Settings): string {
    return lookKeys
        .filter(({ name }) => chosen.has(name))
        .map(({ name, whole }) => {
            const text = String(look[name]);
            return `look.${name} = ${whole ? text : `${text.includes('.') ? text : `${text}.0`}f`};\n`;
        })
        .join('');
}

export function toCpp(settings: Settings): string {
    const { ink, rain } = settings;
    return `Look look;\n${assignments(settings)}const bool withInk = ${ink};\nconst bool raining = ${rain};\n`;
}

export function toJava(settings: Settings): string {
    const { ink, rain } = settings;
    return `Look look = new Look();\n${assignments(settings)}boolean withInk = ${ink};\nboolean raining = ${rain};\n`;
}
