import js from '@eslint/js';
import prettier from 'eslint-config-prettier';
import tseslint from 'typescript-eslint';

export default tseslint.config(
    { ignores: ['dist/', 'node_modules/', 'public/fonts/', 'test-results/'] },
    js.configs.recommended,
    {
        files: ['**/*.{ts,tsx}'],
        extends: [tseslint.configs.strictTypeChecked],
        languageOptions: { parserOptions: { projectService: true } },
        rules: {
            '@typescript-eslint/restrict-template-expressions': ['error', { allowNumber: true }],
            '@typescript-eslint/no-confusing-void-expression': [
                'error',
                { ignoreArrowShorthand: true },
            ],
            eqeqeq: 'error',
        },
    },
    {
        files: ['*.js', 'tools/**/*.js', 'pictures/*.mjs'],
        languageOptions: { globals: { URL: 'readonly', process: 'readonly' } },
    },
    {
        files: ['public/service_worker.js'],
        languageOptions: {
            globals: {
                self: 'readonly',
                caches: 'readonly',
                Headers: 'readonly',
                Request: 'readonly',
                Response: 'readonly',
                URL: 'readonly',
                fetch: 'readonly',
            },
        },
    },
    prettier,
);
