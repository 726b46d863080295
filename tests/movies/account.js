// The account methods: authorised with alice's PIN 1234, then wishlist, purchases, streaming, THX
// and audio settings, and finally the device deactivated.
var store = newExtension(ID), buyPass = 0, rentPass = 0, stream = '';
var VIDEOS = {CurrentPageNumber: 1, ItemsPerPage: 10, purchasetype: 2, typefilter: 0, watchstatus: 3};
var PURCHASE = 'PassID:i,TransactionID:i,TransactionAuthNum:s,' + TAIL, THX = 'LongFormat:s,ShortFormat:s,' + TAIL;
ask(store, 'init', initParams(), ok('b', {'r': true}));
ask(store, 'checkAuthToken', undefined, ok('b', {'r': false}));
ask(store, 'authorizeDevice', {pin: 1234}, ok('AuthToken:s,EmailAddress:s,IsAdultVerificationEnabled:b,DeviceID:s,DeviceName:s,' + TAIL, {
  '/^SIMTOKEN-1-/.test(r.AuthToken)': true, '[r.EmailAddress, r.IsAdultVerificationEnabled, r.DeviceID, r.DeviceName]':
  ['alice@example.com', true, '00-11-22-33-44-55', 'Player type 7']}));
ask(store, 'checkAuthToken', undefined, ok('b', {'r': true}));
ask(store, 'getEmailAddress', undefined, ok('EmailAddress:s,' + TAIL, {'r.EmailAddress': 'alice@example.com'}));
ask(store, 'getBillingInfo', undefined, ok('CCLastFour:s,CCTypeID:i,CCType:s,' + TAIL, {'[r.CCLastFour, r.CCTypeID, r.CCType]': ['4242', 1, 'Visa']}));
ask(store, 'getPrePaidCardBalance', undefined, ok('Balance:i,' + TAIL, {'r.Balance': 2500}));
ask(store, 'getSettingsPageInfo', undefined, ok('Account:s,DeviceID:s,DeviceName:s,' + TAIL, {'r.Account': 'alice@example.com'}));
ask(store, 'getMyVideos', VIDEOS, ok('videos', {'r.Titles': [], 'r.TotalItems': 0}));

ask(store, 'removeAllItemsFromWishlist', undefined, ok('tail'));
ask(store, 'addItemToWishlist', {titleid: 1002}, ok('tail'));
ask(store, 'addItemToWishlist', {titleid: 1003}, ok('tail'));
ask(store, 'getWishlistItems', {sortorder: 1, CurrentPageNumber: 1, ItemsPerPage: 10, typefilter: 0}, ok(SHAPES.videos + ',SortOrder:i', {
  'r.Titles.map(function (t) { return t.TitleID; })': [1002, 1003], 'r.SortOrder': 1}));
ask(store, 'checkTitleInWishlist', {titleid: 1002}, ok('b', {'r': true}));
ask(store, 'checkTitlesInWishlist', {titleids: [1002, 1004, 1003], typefilter: 0}, ok('[b]', {'r': [true, false, true]}));
ask(store, 'removeItemFromWishlist', {titleid: 1002}, ok('tail'));
ask(store, 'checkTitleInWishlist', {titleid: 1002}, ok('b', {'r': false}));

ask(store, 'calcOrderTax', {skuid: 10012}, ok('SubTotal:s,TotalPrice:s,Tax:s,' + TAIL, {'r.SubTotal': '19.99'}));
ask(store, 'doPurchaseSavedBilling', {skuid: 10012, ipaddress: '10.0.0.7', useprepaidfund: false},
    ok(PURCHASE, function (r) { buyPass = r.PassID; }));
ask(store, 'doPurchaseSavedBilling', {skuid: 10021, ipaddress: '10.0.0.7', useprepaidfund: true},
    ok(PURCHASE, function (r) { rentPass = r.PassID; }));
ask(store, 'checkForPurchasedTitle', {titleid: 1001}, ok('b', {'r': true}));
ask(store, 'checkForPurchasedSku', {skuid: 10012}, ok('b', {'r': true}));
ask(store, 'checkForPurchasedSku', {skuid: 10022}, ok('b', {'r': false}));
ask(store, 'getMyVideos', VIDEOS, ok('videos', function (r) {  // a video's RentalPeriod is a text
  eq(r.Titles.map(function (t) { return t.PassID + '/' + t.RentalPeriod; }).sort(), [buyPass + '/', rentPass + '/48 hours'].sort(), 'videos');
}));
ask(store, 'checkRentalExpiration', function () { return {passid: rentPass}; },
    ok('ShouldDisplay:b,HoursRemaining:i,' + TAIL, {'[r.HoursRemaining, r.ShouldDisplay]': [48, false]}));
ask(store, 'assignGiftCertificateToUser', {giftcertificatecode: 'GIFT-1000'}, ok('Balance:i,' + TAIL, {'r.Balance': 2500 - 299 + 1000}));
ask(store, 'checkAdultVerificationEnabled', undefined, ok('IsAdultVerificationEnabled:b,' + TAIL, {'r.IsAdultVerificationEnabled': true}));
ask(store, 'checkAdultVerificationPin', {pin: 7}, ok('IsPinVerified:b,' + TAIL, {'r.IsPinVerified': true}));

ask(store, 'getStreamingAssetLocation', function () { return {passid: buyPass, fileprofile: 1}; },
    ok('location', function (r) { stream = r.StreamID; eq(r.AssetID, buyPass, 'asset of the stream'); }));
ask(store, 'manageStreamingInstanceStatus', function () { return {streamid: stream, streamstatus: 2, stoptimeSeconds: 120}; }, ok('tail'));
ask(store, 'loadLastStreamingAssetLocation', function () { return {passid: buyPass, fileprofile: 1}; }, ok('location', {'r.StreamID == stream': true}));
ask(store, 'getStreamingBonusAssetLocation', {bonusassetid: 10015}, ok('location', {'r.AssetID': 10015}));
ask(store, 'getTHXMediaDirector', function () { return {passid: buyPass, fileprofile: 1, audioprofile: 3}; },
    ok(THX, {'r.ShortFormat': 'THX:STANDARD:Dolby_Digital_Plus_51'}));
ask(store, 'getTHXMediaDirectorBonusAsset', {bonusassetid: 10015, fileprofile: 1, bonusassettype: 0}, ok(THX));
ask(store, 'setAudioDefaultProperty', {audioprofile: 1}, ok('tail'));
ask(store, 'getAudioDefaultProperty', undefined, ok('i', {'r': 1}));
ask(store, 'deactivateDevice', undefined, ok('tail'));
ask(store, 'checkAuthToken', undefined, ok('b', {'r': false}));
run();
