// The inks of the panel, by name.
export const inks: Readonly<Record<string, string>> = {
    'Blue-black': '#0d173d', Blue: '#0d2673', Violet: '#4d1a80', Red: '#99080d', Amber: '#994d05', Green: '#0d5926', Black: '#1c1c1c',
};
