// The library's getTitles series by node-soap, for the benchmark table: the same page of the
// same catalogue service, from the WSDL the build generates, with a WS-Security UsernameToken
// (password digest) and the device-settings header block, against the same simulator.
//
// usage: node titles.js WSDL CALLS
// Environment: SSL_CERT_FILE and VLWS_CONNECT_TO of the simulator, VL_USER, VL_PASSWORD,
// VL_API_KEY. Prints one JSON line: the calls made, CPU and wall time per call in seconds (after
// one untimed call) and the titles of the last page.
'use strict';
const fs = require('fs');
const https = require('https');
const axios = require('axios');
const soap = require('soap');

const [wsdl, calls] = [process.argv[2], Number(process.argv[3])];
const host = 'store.ostrel.example';
const api = `http://${host}/api/`;

// The simulator's address and port for the store host, as VLWS_CONNECT_TO gives them.
const route = process.env.VLWS_CONNECT_TO.split(',').map((e) => e.split(':'))
  .find(([h, p]) => h === host && p === '443');
const agent = new https.Agent({
  ca: fs.readFileSync(process.env.SSL_CERT_FILE),
  lookup: (name, options, done) =>
    options && options.all ? done(null, [{ address: route[2], family: 4 }]) : done(null, route[2], 4),
});

async function main() {
  const client = await soap.createClientAsync(wsdl, {
    endpoint: `https://${host}:${route[3]}/api/RealTimeBrowse.asmx`,
    request: axios.create({ httpsAgent: agent }),
  });
  client.setSecurity(new soap.WSSecurity(process.env.VL_USER, process.env.VL_PASSWORD,
    { passwordType: 'PasswordDigest', hasTimeStamp: false, hasTokenCreated: true, mustUnderstand: true }));
  client.addSoapHeader(`<VL1:DeviceSettings xmlns:VL1="${api}"><VL1:APIKey>${process.env.VL_API_KEY}</VL1:APIKey>` +
    '<VL1:DestinationUniqueID>00-11-22-33-44-55</VL1:DestinationUniqueID>' +
    '<VL1:DestinationTypeID>7</VL1:DestinationTypeID><VL1:AuthToken></VL1:AuthToken></VL1:DeviceSettings>');
  const page = { GenreID: 1, CurrentPageNumber: 1, ItemsPerPage: 20, PurchaseType: 'any' };
  let titles = 0;
  const call = async () => {
    const [answer] = await client.getTitlesByNavigationAsync(page);
    const result = answer.getTitlesByNavigationResult;
    if (result.ResponseCode !== 0) throw new Error(`response code ${result.ResponseCode}`);
    titles = result.Titles.TitleListing.length;
  };
  await call();
  const cpu = process.cpuUsage();
  const start = process.hrtime.bigint();
  for (let i = 0; i < calls; i++) await call();
  const wall = Number(process.hrtime.bigint() - start) / 1e9;
  const used = process.cpuUsage(cpu);
  console.log(JSON.stringify({ calls, cpu: (used.user + used.system) / 1e6 / calls, wall: wall / calls, titles }));
}

main().catch((e) => {
  console.error(e.message || e);
  process.exit(1);
});
