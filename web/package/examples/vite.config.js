import vue from '@vitejs/plugin-vue';

export default {
    base: './',
    esbuild: { jsx: 'automatic' },
    plugins: [vue({ template: { compilerOptions: { isCustomElement: (tag) => tag === 'tidemark-water' } } })],
    build: { rollupOptions: { input: ['react.html', 'vue.html'] } },
};
