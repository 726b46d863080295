// Transcripts: what a client did, as lines of text that a test compares with a file of the
// repository (tests/data/...): the requests the store received and the rows a file cache gained.
#ifndef VLTESTTRANSCRIPT_H
#define VLTESTTRANSCRIPT_H

#include <gtest/gtest.h>

#include <set>
#include <string>
#include <vector>

#include "VLSimServer.h"

// What the store received since the last call, a line per request in the order the client
// connected: "> " and the service and operation (and " token=" and the token sent, if the request
// had the element), or the method, host and path of a plain HTTP request; a connection that sent
// no request has none. The log is emptied.
std::string VLReceivedLines(VLSimServer& sim);

// The rows of the file caches in folder that came ("+ ") or went ("- ") since the rows in kept,
// which become the rows now: each database file's name, and its service answers and user data by
// Name and Key and box art by prefix and size.
std::string VLCacheChanges(const std::string& folder, std::set<std::string>* kept);

// The transcripts of a folder: the names of its ".txt" files without the ending, sorted; and a
// test name made of one (a '-' becomes '_'), for tests that take one transcript each.
std::vector<std::string> VLTranscriptsIn(const std::string& folder);
std::string VLTranscriptTestName(const testing::TestParamInfo<std::string>& info);

// Adds a failure unless transcript is the content of expectedFile (a path below tests/data). The
// failure writes the transcript under the same name below the build's tests folder and gives the
// diff command: an intended change is copied over the expected file.
void VLExpectTranscript(const std::string& expectedFile, const std::string& transcript);

#endif  // VLTESTTRANSCRIPT_H
