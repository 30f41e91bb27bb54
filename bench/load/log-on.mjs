// Logs on customers, opens the whole price list for each, and prints one cookie a line:
// node log-on.mjs BASE COUNT
import http from 'node:http';

const [base, count] = [process.argv[2], Number(process.argv[3])];
const agent = new http.Agent({keepAlive: true, maxSockets: 4});

// Customers of the demo company, each with prices of its own; all of these may order.
const kUsers = Array.from({length: 18}, (_, i) => [`klient${i + 20}`, 'klient-demo']);

function ask(session, page, fields) {
    const body = fields ? new URLSearchParams(fields).toString() : '';
    const headers = {Connection: 'keep-alive', Cookie: session.cookie};
    if (fields) {
        headers['Content-Type'] = 'application/x-www-form-urlencoded';
        headers['Content-Length'] = body.length;
    }
    return new Promise((resolve, reject) => {
        const request = http.request(
            `${base}?page=${page}`, {method: fields ? 'POST' : 'GET', headers, agent}, answer => {
                const cookie = answer.headers['set-cookie'];
                if (cookie) session.cookie = cookie[0].split(';')[0];
                let text = '';
                answer.setEncoding('utf8');
                answer.on('data', part => { text += part; });
                answer.on('end', () => resolve({status: answer.statusCode, text}));
            });
        request.on('error', reject);
        request.end(body);
    });
}

async function openSession(number) {
    const session = {cookie: ''};
    const [user, password] = kUsers[number % kUsers.length];
    await ask(session, 'Logon');
    await ask(session, 'Logon&event=Logon',
              {ZEB_IN_KASUTAJATUNNUS: user, ZEB_IN_PAROOL: password});
    await ask(session, 'Kaubainfo');
    const list = await ask(session, 'Kaubainfo&event=Hinnakiri',
                           {ZEBInText: '', Combo_GRArticleCat: '0', Find_GRArticle: 'Otsi'});
    if (list.status !== 200 || !list.text.includes('name="ID_')) {
        throw new Error(`${user} does not see the price list (status ${list.status})`);
    }
    return session.cookie;
}

let next = 0;
const cookies = [];
async function work() {
    while (next < count) {
        const number = next++;
        cookies[number] = await openSession(number);
    }
}
await Promise.all([work(), work(), work(), work()]);
console.log(cookies.join('\n'));
agent.destroy();
