// The demo's store session, as a store movie runs it: settings, the catalogue with prefetched
// pages and box art, the account, the wishlist, a purchase, streaming, and a storefront page of
// what was browsed. run-demo names the files and the store's credentials in the environment.

var GENRE = 10, PER_PAGE = 8, SERIES = 1151, PIN = 1234;
var settingsFile = getenv('VL_DEMO_SETTINGS_FILE');
var settings = newExtension('com.ostrel.VLCfgLib');
var store = newExtension('com.ostrel.DUDUVud');
var deviceId, token, shown = [], flags = {}, art = {}, pass;

then(function () {
  say('Settings');
  var existed = store.fileExist(settingsFile);
  settings.init('VL_DEMO_CONFIGURATION_FILE', 'VL_DEMO_SETTINGS_FILE');
  deviceId = settings.read('DestinationUniqueID', false);
  token = settings.read('AuthToken', true);
  detail((existed ? 'kept from the last run: ' : 'created: ') + settingsFile);
  detail('device ' + deviceId + ', stored token: ' + (token ? 'yes' : 'none'));
  // The library's own trace goes to log.txt beside the settings file.
  store.setLogAreaIDsAndTargetConfig([{LogAreaIDs: '16128', LogTarget: '2', SettingsFile: settingsFile}]);
  next();
});

then(function () {
  say('Store');
  request('init', {
    APIKey: getenv('VL_DEMO_API_KEY'), UserName: getenv('VL_DEMO_USER'), Password: getenv('VL_DEMO_PASSWORD'),
    DestinationTypeID: 7, DestinationUniqueID: deviceId, AuthToken: token, Type: 0, EnvNum: 2, AccessType: 2,
    CacheType: 2, CacheData: 7, CachePath: getenv('VL_DEMO_CACHE'), CacheLimit: 0,
    firmwareVersion: '1.0', ApplicationRevision: 'demo', modelNumber: 'VL-DEMO'
  }, function (ready, ms) {
    detail('initialised in ' + ms + ' ms: ' + store.getUserAgent() + ', file cache with prefetch');
  });
});

then(function () {
  request('getNavigation', undefined, function (genres) {
    var top = genres.filter(function (g) { return g.ParentID === 0 && g.Visible; });
    detail(genres.length + ' genres; top level: ' + top.map(function (g) { return g.Name; }).join(', '));
  });
});

function showPage(number) {
  then(function () {
    request('getTitles', {genreid: GENRE, CurrentPageNumber: number, ItemsPerPage: PER_PAGE, purchasetype: 2},
            function (page, ms) {
      say('Action, page ' + page.CurrentPageNumber + ' of ' + page.TotalPages + ' (' + ms + ' ms' +
          (number > 1 ? ', fetched in the background while page ' + (number - 1) + ' was shown' : '') + ')');
      page.Titles.forEach(function (t) {
        shown.push(t);
        detail(t.TitleName + ' (' + t.MPAARating + '), ' + priceOf(t));
      });
    });
  });
  then(function () { pause(1500); });
}
showPage(1);
showPage(2);

then(function () {
  var first = shown[0];
  request('getTitleListing', {titleid: first.TitleID}, function (d) {
    say('Details of ' + d.TitleName);
    detail(d.Synopsis);
    detail('directed by ' + d.Directors + '; ' + d.RunTime + '; user rating ' + d.UserRating + '/5');
  });
});
then(function () {
  request('getRecommendedTitles', {titleid: shown[0].TitleID}, function (r) {
    detail('recommended with it: ' + r.Titles.map(function (t) { return t.TitleName; }).join(', '));
  });
});
then(function () {
  request('getTvEpisodeListByTitleID', {titleid: SERIES}, function (r) {
    say('A series: ' + r.Episodes.length + ' episodes');
    r.Episodes.forEach(function (e) { detail(e.EpisodeNumber + '. ' + e.EpisodeName); });
  });
});
then(function () {
  request('searchForTitle', {CurrentPageNumber: 1, ItemsPerPage: 5, purchasetype: 2, typefilter: 0, query: 'Harbor'},
          function (r) {
    say('Search for "Harbor": ' + r.TotalItems + ' titles');
    detail(r.Titles.map(function (t) { return t.TitleName; }).join(', '));
  });
});

// Box art of every title shown: most are in the cache already, downloaded while the movie idled.
then(function () {
  say('Box art');
  var downloads = shown.map(function (t) {
    return function () {
      request('getBoxArtImage', {boxartsize: 1, boxartprefix: t.BoxArtPrefix}, function (file) { art[t.TitleID] = file; });
    };
  });
  downloads.push(function () {
    detail(shown.length + ' images in ' + getenv('VL_DEMO_CACHE'));
    next();
  });
  steps = downloads.concat(steps);
  next();
});

then(function () {
  if (!token) return next();
  request('checkAuthToken', undefined, function (valid) {
    detail('the stored token is ' + (valid ? 'still valid' : 'no longer valid'));
    if (!valid) token = '';
  });
});
then(function () {
  if (token) return next();
  request('authorizeDevice', {pin: PIN}, function (r) {
    token = r.AuthToken;
    say('Account');
    detail('device authorised for ' + r.EmailAddress + ' as "' + r.DeviceName + '"');
    detail('token stored encrypted: ' + settings.write('AuthToken', token, true));
  });
});

then(function () {
  request('addItemToWishlist', {titleid: shown[1].TitleID}, function () {
    say('Wishlist');
    detail('added ' + shown[1].TitleName);
  });
});
then(function () {
  var ids = shown.map(function (t) { return t.TitleID; });
  request('checkTitlesInWishlist', {titleids: ids, typefilter: 0}, function (marks) {
    ids.forEach(function (id, i) { flags[id] = marks[i]; });
    detail('of the ' + ids.length + ' titles shown, on the wishlist: ' +
           shown.filter(function (t) { return flags[t.TitleID]; }).map(function (t) { return t.TitleName; }).join(', '));
  });
});
then(function () {
  request('getWishlistItems', {sortorder: 0, CurrentPageNumber: 1, ItemsPerPage: 10, typefilter: 0}, function (r) {
    detail('titles on the wishlist: ' + r.TotalItems);
  });
});

then(function () {
  var title = shown[0], product = title.AvailableProducts[0];
  request('doPurchaseSavedBilling', {skuid: product.SkuID, ipaddress: '192.0.2.10', useprepaidfund: false},
          function (r) {
    pass = {id: r.PassID, profile: product.AvailableAssets[0].FileProfile};
    say('Purchase');
    detail((product.PurchaseType === 0 ? 'rented ' : 'bought ') + title.TitleName + ' for ' + product.Price +
           ' with the saved card: pass ' + r.PassID + ', transaction ' + r.TransactionID);
  });
});
then(function () {
  request('getStreamingAssetLocation', {passid: pass.id, fileprofile: pass.profile}, function (r) {
    say('Streaming');
    detail('stream ' + r.StreamID + ' from ' + r.StreamingAssetLocation);
    pass.stream = r.StreamID;
  });
});
then(function () {
  request('manageStreamingInstanceStatus', {streamid: pass.stream, streamstatus: 1, stoptimeSeconds: 600}, function () {
    detail('reported: stopped after 600 s');
  });
});
then(function () {
  request('checkBandwidth', undefined, function (bits) {
    say('Bandwidth: ' + Math.round(bits / 1000) + ' kbit/s');
  });
});
then(function () {
  request('deactivateDevice', undefined, function () {
    say('Deactivated');
    detail('token removed from the settings: ' + settings.write('AuthToken', '', true));
  });
});

// The storefront page: what the movie would show, between the lines run-demo cuts it out by.
then(function () {
  print('-----BEGIN STOREFRONT-----');
  print('<!DOCTYPE html><html><head><meta charset="utf-8"><title>Storefront: Action</title><style>' +
        'body{font-family:sans-serif;background:#111;color:#eee}ul{display:flex;flex-wrap:wrap;list-style:none}' +
        'li{width:190px;margin:8px}img{width:175px;display:block}.wish{color:#fc0}</style></head>' +
        '<body><h1>Action</h1><ul>');
  shown.forEach(function (t) {
    print('<li><img src="file://' + escapeHtml(art[t.TitleID]) + '" alt="' + escapeHtml(t.TitleName) + '"><b>' +
          escapeHtml(t.TitleName) + '</b><br>' + escapeHtml(priceOf(t)) +
          (flags[t.TitleID] ? ' <span class="wish">&#9733; wishlist</span>' : '') + '</li>');
  });
  // Records how many images loaded, for a check of the page in a browser.
  print('</ul><script>window.onload=function(){var i=document.images,n=0;for(var k=0;k<i.length;++k)' +
        'if(i[k].naturalWidth>0)++n;document.body.setAttribute("data-loaded",n+"/"+i.length);};</script>' +
        '</body></html>');
  print('-----END STOREFRONT-----');
  say('The session made ' + storeCalls + ' store calls in ' + ((Date.now() - sessionStart) / 1000).toFixed(1) + ' s');
  quit();
});

next();
