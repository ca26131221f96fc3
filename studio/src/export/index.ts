/** A work as what others take: the style file, code of each language that paints it, a command, a PNG. */
import { c } from './c';
import { command } from './command';
import { cppClasses } from './cpp_classes';
import { cppLook } from './cpp_look';
import type { Exporter } from './exported';
import { java } from './java';
import { javascript } from './javascript';
import { python } from './python';
import { style } from './style';

export type { CppOptions, Exported, Exporter, ExportEngine } from './exported';
export { patternFiles, patternPictures } from './patterns';
export { png } from './png';
export { resolved } from './resolve';
export { style as styleFile } from './style';

export type ExportName =
    'style' | 'cpp-look' | 'cpp-classes' | 'c' | 'java' | 'python' | 'javascript' | 'command';

/** In the order in which a person is offered them. */
export const exporters: Readonly<Record<ExportName, Exporter>> = {
    style,
    'cpp-look': cppLook,
    'cpp-classes': cppClasses,
    c,
    java,
    python,
    javascript,
    command,
};
