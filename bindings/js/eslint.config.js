import js from '@eslint/js';
import { defineConfig } from 'eslint/config';
import { configs } from 'typescript-eslint';

export default defineConfig(
    { ignores: ['dist/', 'tests/typed_use.ts'] },
    js.configs.recommended,
    {
        files: ['**/*.ts'],
        extends: [configs.strictTypeChecked, configs.stylisticTypeChecked],
        languageOptions: {
            parserOptions: { projectService: true },
        },
        rules: {
            '@typescript-eslint/restrict-template-expressions': ['error', { allowNumber: true }],
            '@typescript-eslint/no-confusing-void-expression': 'off',
            // Indices that were counted before.
            '@typescript-eslint/no-non-null-assertion': 'off',
            // Checks of what callers without types give.
            '@typescript-eslint/no-unnecessary-condition': 'off',
            '@typescript-eslint/no-unnecessary-type-assertion': 'off',
        },
    },
    {
        files: ['**/*.{js,mjs}'],
        languageOptions: {
            globals: Object.fromEntries(
                Object.getOwnPropertyNames(globalThis).map((name) => [name, 'readonly']),
            ),
        },
    },
    {
        files: ['tests/page/*.js'],
        languageOptions: {
            globals: Object.fromEntries(
                [
                    'Worker',
                    'ImageData',
                    'OffscreenCanvas',
                    'document',
                    'onmessage',
                    'postMessage',
                ].map((name) => [name, name === 'onmessage' ? 'writable' : 'readonly']),
            ),
        },
    },
);
