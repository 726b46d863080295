// The calling contract: immediate codes, init and clone, the synchronous methods, a store failure
// (the harness makes getRecommendedTitles answer HTTP 503), an object dropped while its request
// runs (GetCountryID is delayed 1.5 s) and quitFlash ending the movie.
var store = newExtension(ID), other = newExtension(ID), twin = newExtension(ID), dropped = false;
var never = {onComplete: function () { check(false, 'a completion after an immediate error'); }};
var PAGE = {genreid: 10, CurrentPageNumber: 1, ItemsPerPage: 5, purchasetype: 2}, FILE = SIM.sourceDir + '/tests/movies/common.js';
function answers(table) { for (var e in table) eq(eval(e), table[e], e); }  // {expression: its expected value}

step(function (next) {
  answers({'store.getTitles([never, PAGE])': -1, 'store.getNavigation([never])': -1, 'store.getNavigation(5)': -1,
           'store.clone(store)': -3, 'store.clone(other)': -3, 'store.clone()': -3, 'store.getUserAgent()': '',
           'store.getDeviceEnv()': -5, 'store.getAvailableEnvLists()': -5});
  next();
});
ask(store, 'init', initParams({APIKey: ''}), function (status, r) {
  eq([status, r], [-1000, false], 'status and result of an init without API key');
  eq(store.getNavigation([never]), -1, 'getNavigation after a failed init');
});
ask(store, 'init', initParams(), ok('b', {'r': true}), function () {
  answers({'store.init([never, initParams()])': -2, 'store.getNavigation([never])': -1});
});
step(function (next) {
  answers({'store.init([never, initParams()])': -4, 'store.clone(other)': -4, 'store.getTitles([never, PAGE, {}])': -3,
           'store.getTitles([never, 5])': -3, 'store.getTitles([never])': -3, 'store.getTitles([5, PAGE])': -3,
           'store.getTitles({0: never, 1: PAGE, length: 2})': -3, 'store.getTitles([never], PAGE)': -3,
           'store.getNavigation([never, {}])': -3, 'store.checkTitlesInWishlist([never, {titleids: [], typefilter: 0}])': -3,
           'store.checkTitlesInWishlist([never, {titleids: 1002, typefilter: 0}])': -3,
           'store.trace("two", "arguments")': -3, 'store.trace("hello movie")': 0, 'store.getSysInfo() + store.getSysInfo(5)': '',
           'store.fileExist()': false, 'store.fileExist(FILE)': true, 'store.fileExist(FILE + "x")': false,
           'store.clearLocalCache("")': false, 'store.clearLocalCache()': false, 'store.checkVLSWFmd5sum()': '',
           '/^[0-9a-f]{32}  .*common\\.js\\n$/.test(store.checkVLSWFmd5sum(FILE))': true,
           'store.getUserAgent()': 'VLSDK: 1.0|r7 VLMODEL:TV-1', 'store.getDeviceEnv()': 2,
           'store.getAvailableEnvLists()': [{envNum: 0, endpoint: 'stgapi'}, {envNum: 1, endpoint: 'stg'},
               {envNum: 2, endpoint: 'production'}, {envNum: 3, endpoint: 'default(production)'}],
           'store.setLogAreaIDsAndTargetConfig()': -3, 'store.setLogAreaIDsAndTargetConfig({LogAreaIDs: "0"})': -3,
           'store.setLogAreaIDsAndTargetConfig([{LogAreaIDs: "0", LogTarget: "0"}])': 1,
           'store.setLogAreaIDsAndTargetConfig([{LogAreaIDs: "0", LogTarget: "1"}])': 0, 'store.idle()': 0});
  next();
});
ask(store, 'getTitles', PAGE, ok('page', {'r.GenreID + " " + r.Titles.length': '10 5'}), function () {
  answers({'store.getNavigation([never])': -2, 'store.getTitles([never, PAGE])': -2, 'newExtension(ID).clone(store)': -2});
});
step(function (next) {
  answers({'twin.clone(store)': 0, 'twin.clone(store) ': -4, 'twin.getUserAgent()': 'VLSDK: 1.0|r7 VLMODEL:TV-1'});
  next();
});
ask(twin, 'getTitleListing', {titleid: 1002}, ok('detail', {'r.TitleName': 'Distant Lantern'}));
ask(store, 'getRecommendedTitles', {titleid: 1001}, function (status, r) {
  eq(status, -4503, 'status of HTTP 503');
  if (kind(r, TAIL + ',Titles:[title]', 'result of a failure')) eq(r.Titles, [], 'titles of a failure');
});
step(function (next) {  // dropped while its request runs: nothing is delivered, the movie goes on
  var doomed = newExtension(ID);
  eq(doomed.clone(store), 0, 'clone to drop');
  eq(doomed.getCountryID([{onComplete: function () { dropped = true; }}]), 0, 'request of the dropped object');
  doomed = null;
  Duktape.gc();
  Duktape.gc();
  later(2500, function () { check(!dropped, 'the dropped object delivered'); next(); });
});
ask(store, 'getNavigation', undefined, ok('[genre]'));
ending = function () {
  eq(store.quitFlash(), 0, 'quitFlash');
  later(0, function () { print('FAIL: quitFlash did not end the movie'); exit(1); });
};
run();
