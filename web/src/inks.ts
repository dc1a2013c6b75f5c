// Ink that looks well, by its name.
export const inks: Readonly<Record<string, string>> = {
    Blue: '#0d2673', Violet: '#4d1a80', Red: '#99080d', Amber: '#994d05', Green: '#0d5926', Black: '#1c1c1c',
};
