// Helpers shared by the demo's movie scripts.

// Prints one step of the session: what was called and what it answered.
function show(what, answer) {
  print('demo: ' + what + ' -> ' + JSON.stringify(answer));
}

// Calls every method of an extension object in order, with the same arguments, and shows each
// answer.
function callEach(label, object, methods, args) {
  for (var i = 0; i < methods.length; ++i) {
    show(label + '.' + methods[i], object[methods[i]].apply(object, args || []));
  }
}
