import tseslint from 'typescript-eslint';

export default tseslint.config(
    { ignores: ['dist', 'node_modules'] },
    ...tseslint.configs.strictTypeChecked.map((config) => ({ ...config, files: ['src/**/*.ts'] })),
    {
        files: ['src/**/*.ts'],
        languageOptions: { parserOptions: { projectService: true, tsconfigRootDir: import.meta.dirname } },
        rules: {
            '@typescript-eslint/no-non-null-assertion': 'off', // places that are known to be there
            '@typescript-eslint/restrict-template-expressions': ['error', { allowNumber: true }],
            '@typescript-eslint/no-confusing-void-expression': ['error', { ignoreArrowShorthand: true }],
            'no-restricted-properties': ['error',
                ...['innerHTML', 'outerHTML', 'insertAdjacentHTML', 'write', 'createContextualFragment'].map((property) => (
                    { property, message: 'Texts come from modems: make text nodes.' }))],
            'no-eval': 'error',
            'no-new-func': 'error',
        },
    },
);
