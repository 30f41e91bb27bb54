// Reads statements as SQL Server would: with the grammar of Transact-SQL, and with the few rules of
// the server that no grammar knows.
import { createRequire } from 'node:module';

const require = createRequire(import.meta.url);
const { CharStreams, CommonTokenStream } = require('antlr4ts');
const grammar = 'antlr4ts-sql/dist/src/grammar-output/tsql/';
const { TSqlLexer } = require(grammar + 'TSqlLexer.js');
const { TSqlParser } = require(grammar + 'TSqlParser.js');

// What is right and the grammar does not know, each with what it does know in the same place.
export const exceptions = [
  { name: 'grant of UPDATE', found: /^GRANT UPDATE ON /, instead: 'GRANT INSERT ON ' },
  { name: 'grant of DELETE', found: /^GRANT DELETE ON /, instead: 'GRANT INSERT ON ' },
];

// The functions that SQL Server 2016 has and the portal's statements call.
const functions = new Set(
  `abs avg cast coalesce convert count count_big dateadd datediff day getdate isnull left len lower ltrim
  max min month newid nullif openjson replace right round rtrim scope_identity substring sum
  sysdatetime upper year`.split(/\s+/));

// What else stands before a parenthesis: keywords, types and hints.
const words = new Set(
  `and as by case check default distinct else exists from identity in include key like not on or
  over select then top values when where with add between decimal numeric nvarchar datetime2 having
  join`.split(/\s+/));

const mostParameters = 2100;

class Fault extends Error {}

function tokensOf(text, report) {
  // The grammar has capitals only; texts in quotes stay as they are.
  const capitals = text.replace(/'(?:[^']|'')*'|\[[^\]]*\]|[a-z]+/g, (piece) =>
    /^['[]/.test(piece) ? piece : piece.toUpperCase());
  const lexer = new TSqlLexer(CharStreams.fromString(capitals));
  lexer.removeErrorListeners();
  lexer.addErrorListener(report);
  const stream = new CommonTokenStream(lexer);
  stream.fill();
  return stream;
}

function checkCalls(tokens) {
  tokens.forEach((token, i) => {
    if (tokens[i + 1]?.text !== '(' || !/^\w+$/.test(token.text)) return;
    const name = token.text.toLowerCase();
    const before = tokens[i - 1]?.text;
    const isTable = ['INTO', 'ON', 'REFERENCES', 'TABLE'].includes(before);
    if (!isTable && !functions.has(name) && !words.has(name) && !/^\d+$/.test(name)) {
      throw new Fault(`SQL Server has no function ${name}`);
    }
  });
}

// Throws when SQL Server would not take the statement. Marks ("?") are its parameters.
export function check(statement, counts = {}) {
  let text = statement.trim();
  // Any other name would be the call of a procedure.
  if (!/^(ALTER|CREATE|DELETE|GRANT|INSERT|SELECT|SET|UPDATE) /i.test(text)) {
    throw new Fault('no such statement');
  }
  for (const { name, found, instead } of exceptions) {
    if (!found.test(text)) continue;
    text = text.replace(found, instead);
    counts[name] = (counts[name] ?? 0) + 1;
  }
  let marks = 0;
  text = text.replace(/'(?:[^']|'')*'|\[[^\]]*\]|\?/g, (piece) =>
    (piece === '?' ? `@p${++marks}` : piece));
  if (marks > mostParameters) throw new Fault(`${marks} parameters`);
  const report = {
    syntaxError: (recognizer, symbol, line, column, message) => {
      throw new Fault(`${line}:${column} ${message.slice(0, 200)}`);
    },
  };
  const stream = tokensOf(text, report);
  const parser = new TSqlParser(stream);
  parser.removeErrorListeners();
  parser.addErrorListener(report);
  parser.tsql_file();
  checkCalls(stream.getTokens().filter((token) => token.channel === 0));
}

// What statements that differ only in their texts and quoted names have in common.
export function shapeOf(statement) {
  return statement.replace(/'(?:[^']|'')*'/g, "''").replace(/\[(?:[^\]]|\]\])*\]/g, '[x]');
}

// The statements of a script: each ends with a semicolon at the end of its line.
export function statementsOf(script) {
  return script.replace(/^\s*--.*$/gm, '').split(/;[ \t]*$/m)
    .map((statement) => statement.trim()).filter((statement) => statement !== '');
}
