// The demo's store session: the movie constructs the store and player extension classes by
// their class ids and drives the player through its methods.

print('demo: constructing the extension classes');
var store = newExtension('com.ostrel.DUDUVud');
var player = newExtension('com.ostrel.VLPlayerLibAE');

// The store class answers with its initial results until it is built.
show('store.init', store.init([{ onComplete: function () {} }, {}]));

print('demo: driving the player');
callEach('player', player, [
  'Initialize', 'GetVersion', 'CreatePlayer', 'RegisterEventHandler',
  'THX_IsSupportedOnDevice', 'THX_ProcessContentDescriptors',
  'getSupported3DFormats', 'getConfigured3DFormat', 'set3DMode', 'SetLogAreaIDsConfig',
  'Play', 'GetPlaybackState', 'GetPlaybackTime', 'GetDuration', 'GetCurrentBandwidth',
  'Pause', 'Stop', 'ReleasePlayer', 'Shutdown'
]);

print('demo: the session is over');
quit();
