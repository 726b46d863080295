// The demo's store session: the movie constructs the three extension classes by their class
// ids and drives the player through its methods.

print('demo: constructing the extension classes');
var store = newExtension('com.ostrel.DUDUVud');
var config = newExtension('com.ostrel.VLCfgLib');
var player = newExtension('com.ostrel.VLPlayerLibAE');

// The store and configuration classes answer with their initial results until they are built.
show('store.init', store.init([{ onComplete: function () {} }, {}]));
show('config.read', config.read('AuthToken', true));

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
