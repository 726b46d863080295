// Store failures through the bridge: the harness makes the first request of each method below
// fail once (a certificate for another host, HTTP 503, an answer cut short, a closed connection,
// a SOAP fault, a refusing response code, a bandwidth probe not found). "onComplete" brings the
// status the operation gives for that fault; the same request is then accepted and answered.
var store = newExtension(ID);
var FAILING = [  // method, parameters, status of its fault
  ['getTitleListing', {titleid: 1002}, -5030],
  ['getTitles', {genreid: 10, CurrentPageNumber: 1, ItemsPerPage: 5, purchasetype: 2}, -4503],
  ['authorizeDevice', {pin: 1234}, -4200],  // too little of the answer to reach its body
  ['getEmailAddress', undefined, -2012],
  ['getPrePaidCardBalance', undefined, -6002],
  ['getStreamingBonusAssetLocation', {bonusassetid: 10015}, -1004],
  ['checkBandwidth', undefined, -1901],
];
ask(store, 'init', initParams(), ok('b', {'r': true}));
FAILING.forEach(function (f) {
  ask(store, f[0], f[1], function (status) { eq(status, f[2], f[0] + ' status of its fault'); });
  ask(store, f[0], f[1], function (status) { eq(status, 0, f[0] + ' status after its fault'); });
});
run();
