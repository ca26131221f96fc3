import { createHash } from 'node:crypto';
import { readdirSync, readFileSync, writeFileSync } from 'node:fs';
import { join, relative, sep } from 'node:path';
import type { Plugin } from 'vite';

/**
 * Completes the service worker when all other files of the page are written: with the list of them, and with a
 * version that is the hash of their contents.
 */
export function offline(): Plugin {
    let folder = '';
    return {
        name: 'studio-offline',
        apply: 'build',
        configResolved(config) {
            folder = join(config.root, config.build.outDir);
            if (config.build.outDir.startsWith(sep)) folder = config.build.outDir;
        },
        writeBundle: {
            order: 'post',
            handler() {
                const worker = join(folder, 'service_worker.js');
                const files = filesOf(folder).filter((file) => file !== worker);
                const hash = createHash('sha256');
                for (const file of files) hash.update(readFileSync(file));
                const names = files.map((file) => relative(folder, file).split(sep).join('/'));
                const source = readFileSync(worker, 'utf8')
                    .replace("'VERSION'", JSON.stringify(hash.digest('hex').slice(0, 16)))
                    .replace(
                        "['FILES']",
                        JSON.stringify(['./', ...names.map((name) => `./${name}`)]),
                    );
                writeFileSync(worker, source);
            },
        },
    };
}

function filesOf(folder: string): string[] {
    return readdirSync(folder, { recursive: true, withFileTypes: true })
        .filter((entry) => entry.isFile())
        .map((entry) => join(entry.parentPath, entry.name))
        .sort();
}
