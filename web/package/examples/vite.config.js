import vue from '@vitejs/plugin-vue';

export default {
    base: './',
    esbuild: { jsx: 'automatic' },
    plugins: [vue({ template: { compilerOptions: { isCustomElement: (tag) => tag === 'tidemark-water' } } })],
    optimizeDeps: { exclude: ['tidemark-water'] },  // the server would move the module away from its WebAssembly
    build: { rollupOptions: { input: ['react.html', 'vue.html'] } },
};
