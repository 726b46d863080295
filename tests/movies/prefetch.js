// Prefetching with a cache file: pages around the page shown, afresh after a change of query,
// nothing for a single page, user pages with CacheData 4, and box art while the movie is idle.
// The harness checks the order of the pages and images from the library's log lines and the
// simulator's request log; `probe` (test.SimProbe) counts the simulator's requests so far.
var probe = newExtension('test.SimProbe'), titles = newExtension(ID), user = newExtension(ID);
var DIR = getenv('VL_TEST_CACHE_DIR'), PAGES = 'getTitlesByNavigation', idling = false;
function page(n, purchase, perPage) {
  return {genreid: 1, CurrentPageNumber: n, ItemsPerPage: perPage || 15, purchasetype: purchase};
}
// A verify for requests whose result shape other movies check: status 0 and, when given, the pages.
function succeeds(totalPages) {
  return function (status, r) {
    eq(status, 0, stepName + ' status');
    if (totalPages) eq(r.TotalPages, totalPages, stepName + ' pages');
  };
}
// Waits until probe.count(what) reaches n, then lets the prefetch thread finish its bookkeeping.
function until(what, n) {
  step(function (next) {
    (function poll() {
      if (probe.count(what) < n) return later(10, poll);
      later(500, function () { eq(probe.count(what), n, what + ' requests'); next(); });
    })();
  });
}

step(function (next) {
  eq(titles.setLogAreaIDsAndTargetConfig([{LogAreaIDs: '256', LogTarget: '1'}]), 0, 'log to the console');
  next();
});
ask(titles, 'init', initParams({CacheType: 2, CacheData: 3, CachePath: DIR}), succeeds());
ask(titles, 'getTitles', page(5, 2), succeeds(10));
until(PAGES, 9);
ask(titles, 'getTitles', page(6, 2), succeeds());  // from the cache; only page 10 is new around it
until(PAGES, 10);
ask(titles, 'searchForTitle', {CurrentPageNumber: 1, ItemsPerPage: 1, purchasetype: 2, typefilter: 0, query: 'a'}, succeeds());
ask(titles, 'getTitles', page(5, 0), succeeds(10));  // another purchase type
until(PAGES, 19);
ask(titles, 'getTitles', {genreid: 10, CurrentPageNumber: 1, ItemsPerPage: 100, purchasetype: 2}, succeeds(1));
step(function (next) {
  idling = true;
  (function poll() {
    if (probe.count('/images/boxart/') < 5) return later(5, poll);
    idling = false;
    next();
  })();
});
until(PAGES, 20);
ask(user, 'init', initParams({CacheType: 2, CacheData: 4, CachePath: DIR}), succeeds());
ask(user, 'authorizeDevice', {pin: 5678}, succeeds());
[1001, 1002, 1003].forEach(function (id) { ask(user, 'addItemToWishlist', {titleid: id}, succeeds()); });
ask(user, 'getWishlistItems', {sortorder: 0, CurrentPageNumber: 1, ItemsPerPage: 1, typefilter: 0}, succeeds(3));
until('getWishlistItems', 3);
[10012, 10022].forEach(function (sku) {
  ask(user, 'doPurchaseSavedBilling', {skuid: sku, ipaddress: '10.0.0.1', useprepaidfund: false}, succeeds());
});
ask(user, 'getMyVideos', {CurrentPageNumber: 1, ItemsPerPage: 1, purchasetype: 2, typefilter: 0, watchstatus: 3},
    succeeds(2));
until('getMyStreamingVideos', 2);
// Dropped while its page prefetch runs: the object goes once the thread has ended.
ask(titles, 'getTitles', page(5, 1), function (status) {
  eq(status, 0, 'the last title page');
  titles = null;
  Duktape.gc();
});
var frame = onEnterFrame;
onEnterFrame = function () { if (idling) titles.idle(); frame(); };
run();
