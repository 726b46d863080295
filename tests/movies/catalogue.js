// The catalogue methods and the device queries of an initialised store, without an account.
var store = newExtension(ID);
ask(store, 'init', initParams(), ok('b', {'r': true}));
ask(store, 'getNavigation', undefined, ok('[genre]', {'r.length > 10': true, 'r[0].ID + r[0].Name + r[0].ParentID': '1Movies0'}));
ask(store, 'getTitles', {genreid: 10, CurrentPageNumber: 1, ItemsPerPage: 5, purchasetype: 2}, ok('page', {
  '[r.GenreID, r.CurrentPageNumber, r.ItemsPerPage, r.Titles.length]': [10, 1, 5, 5], 'r.TotalPages > 1': true,
  'r.Titles[0].AvailableProducts.length > 0': true}));
ask(store, 'getTitles', {genreid: 10, CurrentPageNumber: 999, ItemsPerPage: 5, purchasetype: 2},
    ok('page', {'r.Titles': [], 'r.CurrentPageNumber': 999}));
ask(store, 'getTitleListing', {titleid: 1001}, ok('detail', {'r.TitleName': 'Distant Horizon', 'r.BoxArtPrefix': 't1001_',
  'r.IsTHXMediaDirectorEnabled': true, 'r.AvailableProducts[0].SkuID': 10012, 'r.BonusAssets[0].BonusAssetID': 10015}));
ask(store, 'searchForTitle', {CurrentPageNumber: 1, ItemsPerPage: 10, purchasetype: 2, typefilter: 0, query: 'Harbor'}, ok('page', {
  'r.Titles.length > 0 && r.Titles.every(function (t) { return /harbor/i.test(t.TitleName); })': true}));
ask(store, 'searchForTitle', {CurrentPageNumber: 1, ItemsPerPage: 10, purchasetype: 2, typefilter: 0}, function (status, r) {
  eq(status, -1000, 'search without a query');  // an empty query text, which the client refuses
  kind(r, 'page', 'result of a search without a query');
});
ask(store, 'getRecommendedTitles', {titleid: 1001}, ok(TAIL + ',Titles:[title]'));
ask(store, 'translateSkuID', {skuid: 10021}, ok(TAIL + ',TitleID:i', {'r.TitleID': 1002}));
ask(store, 'getTvEpisodeListing', {episodeid: 50002}, ok('detail', {'r.IsTvListing': true, 'r.EpisodeNumber': 2}));
ask(store, 'getTvEpisodeListByTitleID', {titleid: 1151}, ok(TAIL + ',Episodes:[episode]', {'r.Episodes.length': 3,
  'r.Episodes[0]': {EpisodeID: 50001, EpisodeName: 'Episode 1: Restless Harbor', EpisodeNumber: 1}}));
ask(store, 'getAllTvEpisodeListings', {titleid: 1151}, ok('TitleListingResponse:[detail]', {'r.TitleListingResponse.length': 3}));
ask(store, 'getBoxArtImage', {boxartsize: 1, boxartprefix: 't1001_'}, ok('s', {'/^http:.*\\/175\\/t1001_175\\.jpg$/.test(r)': true}));
ask(store, 'getLocalIPAddr', undefined, ok('s', {'/^\\d+\\.\\d+\\.\\d+\\.\\d+$/.test(r)': true}));
ask(store, 'getCountryID', undefined, ok('i', {'r': 1}));
ask(store, 'getFileType', undefined, ok('DRMProvider:i,AccessType:i,FileProfile:i,VideoFormat:i,FileExtension:i', {'r.AccessType': 2}));
ask(store, 'getConfig', undefined, ok(TAIL + ',ConfigurationItem:[item]', {'r.ConfigurationItem[0]': {Key: 'HeartbeatIntervalSeconds', Value: '60'}}));
ask(store, 'updateLocalCache', {operations: 1}, ok('b', {'r': true}));
ask(store, 'checkBandwidth', undefined, ok('i', {'r > 0': true}));
ask(store, 'calcOrderTax', {skuid: 10012}, function (status, r) {  // refused without an account: -1023 and the record
  eq(status, -1023, 'calcOrderTax status without an account');
  if (kind(r, 'SubTotal:s,TotalPrice:s,Tax:s,' + TAIL, 'calcOrderTax')) eq(r.ResponseCode, 1, 'tax response code');
});
run();
