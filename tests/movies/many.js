// 300 catalogue requests, alternating between a store with a memory cache (repeated requests come
// from the cache) and one without, plus a clone made, used once and dropped every 50 requests:
// run under ASan, nothing may leak. The clone is let go inside its own onComplete.
var cached = newExtension(ID), plain = newExtension(ID);
var KINDS = [
  ['getTitles', function (i) { return {genreid: 1, CurrentPageNumber: i % 6 + 1, ItemsPerPage: 8, purchasetype: 2}; }, 'page'],
  ['getTitleListing', function (i) { return {titleid: 1001 + i % 12}; }, 'detail'],
  ['getNavigation', null, '[genre]'],
  ['getTvEpisodeListByTitleID', function (i) { return {titleid: 1151 + i % 4}; }, 'ResponseCode:i,ResponseMessage:s,Episodes:[episode]'],
  ['searchForTitle', function (i) { return {CurrentPageNumber: 1, ItemsPerPage: 4, purchasetype: 2, typefilter: 0, query: ['Harbor', 'Kingdom'][i % 2]}; }, 'page'],
  ['getBoxArtImage', function (i) { return {boxartsize: i % 3, boxartprefix: 't' + (1001 + i) + '_'}; }, 's']
];

ask(cached, 'init', initParams({CacheType: 1, CacheData: 1}), ok('b'));
ask(plain, 'init', initParams(), ok('b'));
for (var i = 0; i < 300; ++i) (function (i) {
  var k = KINDS[Math.floor(i / 2) % KINDS.length];
  ask(i % 2 ? plain : cached, k[0], k[1] ? k[1](i) : undefined, ok(k[2]));
  if (i % 50 === 49) step(function (next) {
    var copy = newExtension(ID);
    eq(copy.clone(cached), 0, 'clone ' + i);
    eq(copy.getNavigation([{onComplete: function (status) { eq(status, 0, 'navigation of clone ' + i); copy = null; next(); }}]), 0, 'request of clone ' + i);
  });
})(i);
run();
