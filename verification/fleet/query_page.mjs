// Runs the queries of docs/fleet.md on the sample fleet and compares what comes out with the tables below them.
//
// usage: node query_page.mjs FOLDER-OF-NODE-MODULES [--write]
// With --write the page's tables are replaced by what came out.
import {cpSync, mkdtempSync, readFileSync, rmSync, writeFileSync} from 'node:fs';
import {createRequire} from 'node:module';
import {tmpdir} from 'node:os';
import {dirname, join, resolve} from 'node:path';
import {fileURLToPath} from 'node:url';

const here = dirname(fileURLToPath(import.meta.url));
const pageFile = join(here, '../../docs/fleet.md');
const [modules, option] = process.argv.slice(2);
const {DuckDBInstance} = createRequire(resolve(modules, 'package.json'))('@duckdb/node-api');

/// A block of queries, and the lines of the table that follows it.
const BLOCK = /^```sql\n(.*?)^```\n(?:\n((?:\|[^\n]*\n)+))?/gms;

function tableOf(columns, rows) {
  const texts = rows.map(row => row.map(value => (value === null ? '' : String(value))));
  const widths = columns.map((name, at) => Math.max(3, name.length, ...texts.map(row => row[at].length)));
  const line = cells => `| ${cells.map((text, at) => text.padEnd(widths[at])).join(' | ')} |\n`;
  return [line(columns), line(widths.map(width => '-'.repeat(width))), ...texts.map(line)].join('');
}

/// The last query's table; none where it gives no rows to look at.
async function answer(connection, queries) {
  const statements = await connection.extractStatements(queries);
  for (let at = 0; at < statements.count; ++at) {
    const reader = await (await statements.prepare(at)).runAndReadAll();
    if (at + 1 === statements.count && isQuestion(queries)) return tableOf(reader.columnNames(), reader.getRows());
  }
  return '';
}

function isQuestion(queries) {
  const last = queries.trim().replace(/;$/, '').split(';').at(-1).trim();
  return /^(SELECT|WITH|FROM)\b/.test(last);
}

async function newPage(page, connection) {
  const faults = [];
  let written = '', after = 0, blocks = 0;
  for (const [whole, queries, table = ''] of [...page.matchAll(BLOCK)]) {
    const at = page.indexOf(whole, after);
    const line = page.slice(0, at).split('\n').length;
    let got = table;
    try {
      got = await answer(connection, queries);
    } catch (error) {
      faults.push(`docs/fleet.md:${line}: ${error.message}`);
    }
    if (got !== table) faults.push(`docs/fleet.md:${line}: the page has\n${table}and the query gives\n${got}`);
    written += page.slice(after, at) + '```sql\n' + queries + '```\n' + (got && '\n' + got);
    after = at + whole.length;
    ++blocks;
  }
  return {text: written + page.slice(after), faults, blocks};
}

async function main() {
  const folder = mkdtempSync(join(tmpdir(), 'fleet.'));
  try {
    cpSync(join(here, 'results'), join(folder, 'results'), {recursive: true});
    process.chdir(folder);
    const connection = await (await DuckDBInstance.create(':memory:', {threads: '1'})).connect();
    const page = readFileSync(pageFile, 'utf8');
    const {text, faults, blocks} = await newPage(page, connection);
    if (option === '--write') writeFileSync(pageFile, text);
    for (const fault of faults) console.log(fault);
    console.log(`${blocks} blocks of queries, ${faults.length} faults`);
    return faults.length || blocks === 0 ? 1 : 0;
  } finally {
    process.chdir(here);
    rmSync(folder, {recursive: true});
  }
}

process.exitCode = await main();
