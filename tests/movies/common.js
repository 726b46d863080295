// Shared by the movies of DUDUVudAE_test (after the harness's SIM: APIKey, UserName, Password,
// sourceDir): checks, result shapes and a step sequencer. A movie queues steps, then calls run().
var ID = 'com.ostrel.DUDUVud', failures = [], finished = false, done = false, timers = [], deadline = 0, ending = null;
var steps = [], stepIndex = 0, stepName = '';

function check(ok, what) {
  if (!ok) { failures.push(what); print('FAIL: ' + what); }
  return ok;
}
function eq(actual, expected, what) {
  return check(JSON.stringify(actual) === JSON.stringify(expected) && typeof actual === typeof expected,
               what + ': got ' + JSON.stringify(actual) + ', want ' + JSON.stringify(expected));
}

// Shapes: "Name:kind,..." with kind i (integer), s, b, d (Date), a shape, or [kind] (an array);
// a name of SHAPES stands for its text.
var TAIL = 'ResponseCode:i,ResponseMessage:s', SHAPES = {
  bonus: 'BonusAssetID:i,Profile:i,BonusType:i', asset: 'FileProfile:i', item: 'Key:s,Value:s', tail: TAIL,
  audio: 'AssetAudioID:i,FileLocation:s,ContainsVideo:b,AudioAssetProfile:i',
  product: 'SkuID:i,PurchaseType:i,Price:s,RentalPeriod:i,AvailableAssets:[asset],AvailableAudioProfiles:[audio],ExpireDate:d',
  title: 'TitleID:i,TitleName:s,BoxArtPrefix:s,TitlePosition:i,EpisodeNumber:i,CHVRSRating:s,LoyaltyPointsForBuy:s,' +
      'LoyaltyPointsForRent:s,BonusAssets:[bonus],IsTvListing:b,MPAARating:s,IsTHXMediaDirectorEnabled:b,' +
      'IsTHXMediaDirectorEnabledForTrailer:b,AvailableProducts:[product]',
  genre: 'ID:i,Name:s,Visible:b,ParentID:i', episode: 'EpisodeID:i,EpisodeName:s,EpisodeNumber:i',
  location: 'StreamingAssetLocation:s,AssetID:i,StreamID:s,DRMServerURL:s,DRMACKServerURL:s,Status:i,' +
      'StartTimeSeconds:i,HeartbeatURL:s,HeartbeatPollInSeconds:i,' + TAIL
};
SHAPES.detail = TAIL + ',Synopsis:s,UserRating:i,Directors:s,Actors:s,Writers:s,Producers:s,Copyright:s,RunTime:s,' +
    'RatingReason:s,' + SHAPES.title;
SHAPES.page = 'GenreID:i,CurrentPageNumber:i,ItemsPerPage:i,TotalPages:i,TotalItems:i,' + TAIL + ',Titles:[title]';
SHAPES.video = SHAPES.title + ',EpisodeID:i,TvListingTitleID:i,PurchaseType:i,Status:i,RentalPeriod:s,PassID:i,' +
    'PlayStatus:i,StartTimeSeconds:i';
SHAPES.videos = 'CurrentPageNumber:i,ItemsPerPage:i,TotalPages:i,TotalItems:i,' + TAIL + ',Titles:[video]';

function kind(v, k, what) {
  var inner = /^\[(.*)\]$/.exec(k), fields, names = [], i;
  if (k === 'i') return check(typeof v === 'number' && v % 1 === 0, what + ' is an integer, not ' + JSON.stringify(v));
  if (k === 's' || k === 'b') return check(typeof v === {s: 'string', b: 'boolean'}[k], what + ' is ' + k + ', not ' + typeof v);
  if (k === 'd') return check(v instanceof Date && !isNaN(v.getTime()), what + ' is a Date');
  if (inner) {
    if (!check(Array.isArray(v), what + ' is an array')) return false;
    for (i = 0; i < v.length; ++i) kind(v[i], inner[1], what + '[' + i + ']');
    return true;
  }
  fields = (SHAPES[k] || k).split(',');
  if (!check(v !== null && typeof v === 'object' && !Array.isArray(v), what + ' is an object, not ' + JSON.stringify(v))) return false;
  for (i = 0; i < fields.length; ++i) names.push(fields[i].split(':')[0]);
  if (!eq(Object.keys(v).join(','), names.join(','), what + ' properties')) return false;
  for (i = 0; i < fields.length; ++i) kind(v[names[i]], fields[i].split(':')[1], what + '.' + names[i]);
  return true;
}

function initParams(extra) {
  var p = {APIKey: SIM.APIKey, UserName: SIM.UserName, Password: SIM.Password, DestinationTypeID: 7,
           DestinationUniqueID: '00-11-22-33-44-55', AuthToken: '', EnvNum: 2, AccessType: 2, Type: 0, CacheType: 0,
           CacheData: 0, CachePath: '', CacheLimit: 0, firmwareVersion: '1.0', ApplicationRevision: 'r7', modelNumber: 'TV-1'};
  for (var k in extra || {}) p[k] = extra[k];
  return p;
}

// A step is a function taking next. ask() queues a request: params undefined sends [callback]
// only, a function is called when the step starts; verify gets (status, result); during() runs
// right after the request was accepted.
function step(fn) { steps.push(fn); }
function ask(store, method, params, verify, during) {
  step(function (next) {
    var calls = 0, p = typeof params === 'function' ? params() : params;
    var cb = {onComplete: function (status, result) {
      if (!eq(++calls, 1, method + ' completions')) return;
      try { verify(status, result); } catch (e) { check(false, method + ': ' + e); }
      next();
    }};
    stepName = method + ' (step ' + stepIndex + ')';
    if (!eq(store[method](p === undefined ? [cb] : [cb, p]), 0, stepName + ' immediate code')) return next();
    if (during) during();
  });
}
// A verify: status 0, the shape, ResponseCode 0 where there is one, then want: a function of the
// result, or {expression of r: expected value}.
function ok(form, want) {
  return function (status, r) {
    if (!eq(status, 0, stepName + ' status') || !kind(r, form, stepName)) return;
    if (r && r.ResponseCode !== undefined) eq(r.ResponseCode, 0, stepName + ' ResponseCode');
    if (typeof want === 'function') return want(r);
    for (var e in want || {}) eq(new Function('r', 'return ' + e)(r), want[e], stepName + ': ' + e);
  };
}
function later(ms, fn) { timers.push({at: Date.now() + ms, fn: fn}); }
function run() {
  if (done) return;
  if (stepIndex >= steps.length) return finish();
  stepName = 'step ' + stepIndex;
  deadline = Date.now() + 30000;
  steps[stepIndex++](run);
}
function finish() {
  done = true;
  print(failures.length + ' failure(s) in ' + steps.length + ' steps');
  if (failures.length) return exit(1);
  finished = true;
  if (ending) ending(); else exit(0);
}
onEnterFrame = function () {
  var now = Date.now();
  timers.slice().forEach(function (t) { if (t.at <= now) { timers.splice(timers.indexOf(t), 1); t.fn(); } });
  if (!done && now > deadline) { check(false, stepName + ' got no completion'); finish(); }
};
