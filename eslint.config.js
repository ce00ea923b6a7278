// Rules for the scripts of the HTML report and their tests.

import js from '@eslint/js';
import globals from 'globals';

export default [
  {ignores: ['build/', 'out/']},
  js.configs.recommended,
  {
    languageOptions: {ecmaVersion: 2022, sourceType: 'module'},
    linterOptions: {reportUnusedDisableDirectives: 'error'},
    rules: {
      'consistent-return': 'error',
      'curly': ['error', 'multi-line'],
      'eqeqeq': 'error',
      'max-len': ['error', {code: 100}],
      'max-lines': ['error', 300],
      'max-lines-per-function': ['error', {max: 60, skipComments: true}],
      'no-implicit-globals': 'error',
      'no-param-reassign': 'error',
      'no-shadow': 'error',
      'no-var': 'error',
      'prefer-const': 'error',
      'quotes': ['error', 'single', {avoidEscape: true}],
      'semi': 'error',
    },
  },
  {
    files: ['io/drawing/html/**/*.js'],
    languageOptions: {globals: globals.browser},
  },
  {
    files: ['tests/page/**/*.js', 'eslint.config.js'],
    languageOptions: {globals: globals.node},
    // The cases of a suite are functions within one.
    rules: {'max-lines-per-function': 'off'},
  },
];
