// The demo's configuration part: the movie keeps its settings through the configuration
// extension. The two files are named by environment variables (see run-demo).

print('demo: the configuration extension');
var settings = newExtension('com.ostrel.VLCfgLib');

// init finds the configuration file's newer format version and starts the settings file with
// that version and a new device identifier.
show('settings.init', settings.init('VL_DEMO_CONFIGURATION_FILE', 'VL_DEMO_SETTINGS_FILE'));
show('settings.read XMLVersion', settings.read('XMLVersion', false));
show('settings.read DestinationUniqueID', settings.read('DestinationUniqueID', false));
show('settings.read Server (from the configuration file)', settings.read('Server', false));

// Plain and encrypted settings: the token is stored with its own password and a check.
show('settings.write Language', settings.write('Language', 'en-US', false));
show('settings.read Language', settings.read('Language', false));
show('settings.write AuthToken (encrypted)', settings.write('AuthToken', 'demo-token-0815', true));
show('settings.read AuthToken (decrypted)', settings.read('AuthToken', true));
var stored = settings.read('AuthToken', false);
show('AuthToken as stored: ' + stored.length + ' characters, hides the token',
     stored.indexOf('demo-token-0815') < 0);

// Each environment has a settings file of its own beside the base file.
show('settings.selectEnv(0) stgapi', settings.selectEnv(0));
show('settings.read Language (stgapi)', settings.read('Language', false));
show('settings.write Language (stgapi)', settings.write('Language', 'de-DE', false));
show('settings.read Language (stgapi)', settings.read('Language', false));
show('settings.selectEnv(3) default', settings.selectEnv(3));
show('settings.read Language (default)', settings.read('Language', false));
show('settings.clearEnv(0)', settings.clearEnv(0));
show('settings.selectEnv(9)', settings.selectEnv(9));
