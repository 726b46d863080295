// FuzzAnswer: a SOAP context's connection callbacks replaced by a peer in memory, so that the
// client's own readers take a fuzzer's input as the answer of a store host. Every connection
// opens; what the client sends is dropped; the answer is received in pieces of the given size
// (TCP may cut an answer anywhere) and then the connection ends.
#ifndef FUZZANSWER_H
#define FUZZANSWER_H

#include <stddef.h>
#include <stdint.h>

#include "VL_WS.h"
#include "stdsoap2.h"

class FuzzAnswer {
 public:
  // Replaces the open, send, receive and close callbacks of context (after the transport's
  // Install, which they bypass).
  static void Install(soap* context);
  // The answer the next connections receive: data (kept by the caller) in pieces of at most
  // piece bytes (at least 1).
  static void Set(const uint8_t* data, size_t size, size_t piece);
  // Splits a fuzzer's input into a selector (its first byte), a piece size (its second byte)
  // and the answer (the rest), and sets the answer. False for an input shorter than two bytes.
  static bool Take(const uint8_t* data, size_t size, uint8_t* selector);

  // The process's one client handle of the production store, made at the first call with the
  // cache type (0 none, 1 memory: answers and user data), its three service contexts installed.
  // Its initialisation asks nothing of the store without a cache; with one, the question for the
  // catalogue's time is refused (VLWS_CONNECT_TO sends it to loopback port 1) and changes nothing.
  static VL_WS_Handle* Handle(int cacheType);
};

// Calls a client operation with the arguments and a record of its own, then releases the record.
template <class Record, class... Params, class... Args>
void FuzzRun(VL_WS_Status (*operation)(VL_WS_Handle*, Params...), VL_WS_Handle* handle, Args... args) {
  Record record;
  operation(handle, args..., &record);
  VL_WS_release(&record);
}

#endif  // FUZZANSWER_H
