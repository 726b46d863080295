// VLSimSoap: what the SOAP operations of the simulated services share — the call's context
// (reached through soap->user) and the helpers that fill response records. Internal to the
// simulator library: VLSimSoap.cpp runs the calls, VLSimRecords.cpp builds the catalogue records,
// VLSim*Ops.cpp implement the operations of the generated service classes.
#ifndef VLSIMSOAP_H
#define VLSIMSOAP_H

#include <string>

#include "VLSimContext.h"
#include "soapH.h"

struct VLSimCall {
  VLSimContext* context = nullptr;
  VLSimService service = VLSimService::kRealTimeBrowse;
  VLSimRequest* entry = nullptr;
  std::string deviceId;  // from the device-settings block
  int deviceType = 0;
  std::string token;
  bool forceCode = false;  // a "code:N" fault
  int forcedCode = 0;
  void* exchange = nullptr;  // the bytes in and out, owned by VLSimSoap.cpp
};

inline VLSimCall& VLSimCallOf(struct soap* soap) { return *static_cast<VLSimCall*>(soap->user); }
inline VLSimStore& VLSimStoreOf(struct soap* soap) { return *VLSimCallOf(soap).context->store; }
inline const VLSimCatalogue& VLSimCatalogueOf(struct soap* soap) { return VLSimCallOf(soap).context->catalogue; }

// The account that the call's token authorises for the calling device, or 0.
int VLSimAccountOf(struct soap* soap);

// A copy of text in the call's memory.
inline char* VLSimText(struct soap* soap, const std::string& text) { return soap_strdup(soap, text.c_str()); }

// Sets ResponseCode and ResponseMessage of any result that has them (a "code:N" fault replaces
// the code) and notes the code in the request log; returns the result.
template <typename Result>
Result* VLSimReply(struct soap* soap, Result* result, int code, const std::string& message = std::string()) {
  VLSimCall& call = VLSimCallOf(soap);
  std::string text = message;
  if (call.forceCode) {
    code = call.forcedCode;
    text = "Response code injected by the simulator";
  }
  result->ResponseCode = code;
  result->ResponseMessage = VLSimText(soap, text.empty() ? (code ? "The request failed" : "OK") : text);
  call.entry->responseCode = code;
  return result;
}

// ---- Catalogue records (VLSimRecords.cpp) ----

// Fills the title fields of a listing (a VL1__TitleListing or a record that extends it). The
// products are those of the purchase type (0 rent, 1 buy, anything else all); an episode's
// listing carries the episode's number and products.
void VLSimFillTitle(struct soap* soap, const VLSimTitle& title, const VLSimEpisode* episode, int purchaseType,
                    VL1__TitleListing* listing);
// The full listing of a title or episode for the account (0: none) as getTitleListing answers it.
VL1__TitleListingResponse* VLSimTitleListingResponse(struct soap* soap, const VLSimTitle& title,
                                                     const VLSimEpisode* episode, int account);
// One page of titles: TotalItems, TotalPages and the page's titles (the last page may be partial,
// a page beyond the last is empty); ItemsPerPage below 1 answers kBadRequest.
VL1__GetTitlesResponse* VLSimTitlesPage(struct soap* soap, const std::vector<const VLSimTitle*>& titles, int genre,
                                        int page, int itemsPerPage, int purchaseType);
// The paging arithmetic shared by every paged answer.
struct VLSimPage {
  int first = 0;  // index of the first item on the page
  int count = 0;  // items on the page
  int totalPages = 0;
};
VLSimPage VLSimPaging(int totalItems, int page, int itemsPerPage);

// An operation that two services offer with the same request and response elements: both
// generated methods call function(soap, request, response).
#define VL_SIM_SHARED_OPERATION(ServiceA, ServiceB, operation, function)                             \
  int ServiceA::operation(_VL1__##operation* request, _VL1__##operation##Response& response) {      \
    return function(soap, request, response);                                                      \
  }                                                                                                \
  int ServiceB::operation(_VL1__##operation* request, _VL1__##operation##Response& response) {      \
    return function(soap, request, response);                                                      \
  }

#endif  // VLSIMSOAP_H
