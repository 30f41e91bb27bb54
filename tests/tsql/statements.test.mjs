// Checks what SQL Server is asked: the scripts of database/sqlserver, and the statements that the
// test programs wrote into the folder $ZEBTELL_TSQL.
import assert from 'node:assert/strict';
import { readdirSync, readFileSync } from 'node:fs';
import { test } from 'node:test';

import { check, exceptions, shapeOf, statementsOf } from './server_parser.mjs';

const scripts = new URL('../../database/sqlserver/', import.meta.url);

function script(name) {
  return statementsOf(readFileSync(new URL(name, scripts), 'utf8'));
}

// Every statement that has been recorded, by the program that asked for it.
function recorded() {
  const folder = process.env.ZEBTELL_TSQL;
  assert.ok(folder, 'ZEBTELL_TSQL names no folder');
  return new Map(readdirSync(folder).map((name) => [
    name, readFileSync(`${folder}/${name}`, 'utf8').split('\n').filter((line) => line !== '')]));
}

function faultsOf(statements, counts) {
  const shapes = new Map(statements.map((statement) => [shapeOf(statement), statement]));
  return [...shapes.values()].flatMap((statement) => {
    try {
      check(statement, counts);
      return [];
    } catch (fault) {
      return [`${fault.message}: ${statement}`];
    }
  });
}

test('what SQL Server refuses is refused', () => {
  const refused = [
    'select from A', 'select a. from A', 'select (a from A', "select 'a from A", 'select `a` from A',
    'select * from A limit 10', 'select top 5 from A', 'select a > b as c from A',
    'select exists (select 1 from A) as c', 'select case when a then 1 end as c from A',
    'select * from A where true', 'select * from A where a', 'select * from A where not a',
    'select * from A where a is true', 'select * from A where a in ()', 'select * from A join B',
    'select * from A offset 5', 'select * from A with nolock', 'select a b c from A',
    'select ifnull(a, b) as c from A', "select datetime('now') as c from A", 'select erp_div(a, b) from A',
    'select a from A where a in (select value from json_each(?))', 'selec 1', 'pragma foreign_keys',
    'insert into A (a) values', 'insert or ignore into A (a) values (1)', 'replace into A values (1)',
    'update A set where ID = 1', 'delete from A where', 'grant select A to b',
    'create table A (ID integer primary key autoincrement)',
    `select a from A where a in (${Array(2101).fill('?').join(', ')})`,
  ];
  assert.deepEqual(refused.filter((statement) => faultsOf([statement]).length === 0), []);
});

test('SQL Server takes every statement that the runtime asks it', () => {
  const programs = recorded();
  for (const [program, least] of [['erp_tests', 200], ['portal_tests', 50], ['demo_tests', 20]]) {
    const statements = programs.get(program) ?? [];
    assert.ok(statements.length >= least, `${program} recorded ${statements.length}`);
    assert.deepEqual(faultsOf(statements), []);
  }
  const all = [...programs.values()].flat().join('\n').toLowerCase();
  const constructs = [
    'openjson(cast(? as nvarchar(max))) with', 'set identity_insert grarticle on; insert into',
    "escape '\\'", 'with (nolock)', 'top (', 'with (updlock, holdlock)',
    'insert into sdorderrow', 'update sdorder ', 'delete from gdtax', 'left join', 'exists (',
    'cast(', 'group by', 'count_big', 'nullif(', 'case when', ' as [',
  ];
  assert.deepEqual(constructs.filter((construct) => !all.includes(construct)), []);
});

test('SQL Server takes the scripts', () => {
  const counts = {};
  for (const name of readdirSync(scripts)) {
    const statements = script(name);
    assert.ok(statements.length > 1, name);
    assert.deepEqual(faultsOf(statements, counts), [], name);
  }
  console.log('what the grammar does not know:', counts);
  assert.deepEqual(Object.keys(counts).sort(), exceptions.map(({ name }) => name).sort());
});

test('the login may write what is written, and nothing else', () => {
  const written = new Set();
  const programs = recorded();
  for (const statement of [...programs.get('erp_tests'), ...programs.get('portal_tests')]) {
    const found = /^(INSERT INTO|UPDATE|DELETE FROM) (\w+)/i.exec(statement);
    if (found) written.add(`${found[1].split(' ')[0].toUpperCase()} ${found[2]}`);
  }
  const granted = script('grants.sql').map((statement) => /^GRANT (\w+) ON (\w+) TO /.exec(statement))
    .filter((grant) => grant && grant[1] !== 'SELECT').map((grant) => `${grant[1]} ${grant[2]}`);
  assert.deepEqual([...written].sort(), granted.sort());
});
