/** Of the package, and of the modules that it takes. */
export const VERSION = '0.9.0';
