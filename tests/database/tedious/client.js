'use strict';
// Logs in, calls stored procedures in turn and prints what came back, as JSON. The plan is JSON on standard input:
//   {"port": 1433, "password": "x", "version": "7_4",
//    "calls": [{"procedure": "p", "inputs": [["Name", "VarChar", "x"]], "outputs": [["ID", "Int"]]}]}
// Printed is {"error": {number, message}} when the login fails, else {"results": [{sets, outputs, status, error}]}.

const { Connection, Request, TYPES } = require('tedious');

function settings(plan) {
    return {
        server: '127.0.0.1',
        authentication: { type: 'default', options: { userName: 'sa', password: plan.password } },
        options: {
            port: plan.port,
            tdsVersion: plan.version,
            database: 'CrvSql',
            encrypt: false,
            connectTimeout: 5000,
            requestTimeout: 10000,
            rowCollectionOnRequestCompletion: false,
        },
    };
}

function told(error) {
    return error ? { number: error.number ?? null, message: error.message } : null;
}

function log_in(plan) {
    return new Promise((resolve, reject) => {
        const connection = new Connection(settings(plan));
        connection.connect((error) => (error ? reject(error) : resolve(connection)));
    });
}

function call(connection, { procedure, inputs, outputs }) {
    return new Promise((resolve) => {
        const result = { sets: [], outputs: {}, status: null, error: null };
        const request = new Request(procedure, (error) => resolve({ ...result, error: told(error) }));
        request.on('columnMetadata', (columns) => result.sets.push({ columns: columns.map((c) => c.colName), rows: [] }));
        request.on('row', (columns) => result.sets.at(-1).rows.push(columns.map((c) => c.value)));
        request.on('returnValue', (name, value) => { result.outputs[name] = value; });
        request.on('doneProc', (count, more, status) => { result.status = status; });
        for (const [name, type, value] of inputs) request.addParameter(name, TYPES[type], value);
        for (const [name, type] of outputs) request.addOutputParameter(name, TYPES[type]);
        connection.callProcedure(request);
    });
}

async function main() {
    const plan = JSON.parse(require('fs').readFileSync(0, 'utf8'));
    let connection;
    try {
        connection = await log_in(plan);
    } catch (error) {
        return { error: told(error.cause ?? error) };
    }
    const results = [];
    for (const wanted of plan.calls) results.push(await call(connection, wanted));
    connection.close();
    return { results };
}

main().then((outcome) => console.log(JSON.stringify(outcome)));
