// Helpers of the demo movie: the transcript, and the session as a chain of steps in which each
// store request hands on to the next step from its onComplete.

var steps = [], storeCalls = 0, sessionStart = Date.now(), idling = false;

function say(text) { print(text); }
function detail(text) { print('    ' + text); }

// Queues a step: a function that ends by calling next(), now or from a completion.
function then(step) { steps.push(step); }
function next() {
  var step = steps.shift();
  if (step) step();
}

// Sends one store request. done(result, milliseconds) runs on completion; a refused request or a
// failed one ends the session, since every later step builds on it.
function request(method, params, done) {
  var sent = Date.now();
  ++storeCalls;
  var callback = {onComplete: function (status, result) {
    if (status !== 0) {
      say('  ' + method + ' failed with status ' + status);
      return exit(1);
    }
    done(result, Date.now() - sent);
    next();
  }};
  var code = store[method](params === undefined ? [callback] : [callback, params]);
  if (code !== 0) {
    say('  ' + method + ' was refused with code ' + code);
    exit(1);
  }
}

// A pause of ms milliseconds during which the movie tells the store it is idle, so that waiting
// box art is downloaded in the background.
function pause(ms) {
  var until = Date.now() + ms;
  idling = true;
  (function wait() {
    if (Date.now() < until) return later(wait);
    idling = false;
    next();
  })();
}

var waiting = [];
function later(fn) { waiting.push(fn); }
onEnterFrame = function () {
  if (idling) store.idle();
  var due = waiting;
  waiting = [];
  for (var i = 0; i < due.length; ++i) due[i]();
};

// The lowest price of a title, as the store writes it.
function priceOf(title) {
  var products = title.AvailableProducts, best = null;
  for (var i = 0; i < products.length; ++i) {
    var p = products[i];
    if (best === null || parseFloat(p.Price) < parseFloat(best.Price)) best = p;
  }
  return best ? (best.PurchaseType === 0 ? 'rent ' : 'buy ') + best.Price : 'not for sale';
}

function escapeHtml(text) {
  return String(text).replace(/&/g, '&amp;').replace(/</g, '&lt;').replace(/>/g, '&gt;').replace(/"/g, '&quot;');
}
