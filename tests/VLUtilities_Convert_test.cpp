// Record conversion: store answers read by the SOAP runtime from XML, converted into client
// records, written as the command-line client writes them, and released (the sanitizer build
// checks that nothing leaks, so an element released by a wrong tag shows). The cases are in
// tests/data/convert.txt: a line "< TYPE XML" is the content of an answer element of that schema
// type, followed by the record it gives; "#" lines and blank lines are comments. vlws's transcript
// of every operation shows the answers as the simulator sends them; these are what it does not
// send: missing and nil elements, numbers for enumerations, date-times of every form.
#include <gtest/gtest.h>

#include <functional>
#include <map>
#include <sstream>
#include <string>

#include "VLRecord.h"
#include "VLRecordJson.h"
#include "VLStoreHosts.h"
#include "VLTestDir.h"
#include "VLTestTranscript.h"
#include "VLUtilities.h"
#include "soapH.h"

namespace {

// Reads one element of a schema type from XML, converts it and writes the record; a line saying
// so when the XML cannot be read.
typedef std::function<std::string(soap*, const std::string& xml)> Conversion;

template <class Schema, class Record>
Conversion Of(Schema* (*make)(soap*, int), void (*convert)(const Schema*, Record&)) {
  return [make, convert](soap* context, const std::string& xml) -> std::string {
    std::istringstream in("<r xmlns:VL1=\"" VL_API_NAMESPACE "\" xmlns:xsi=\"http://www.w3.org/2001/XMLSchema-instance\">" +
                          xml + "</r>");
    context->is = &in;
    Schema* schema = make(context, -1);
    bool read = soap_begin_recv(context) == SOAP_OK && schema->soap_in(context, "r", nullptr) != nullptr &&
                soap_end_recv(context) == SOAP_OK;
    context->is = nullptr;
    if (!read) return "cannot read the XML\n";
    Record record;
    convert(schema, VLRecordInit(record));
    VLJsonWriter json;
    VLJsonValue(json, record);
    EXPECT_EQ(VL_WS_OK, VL_WS_release(&record));
    return json.Text();
  };
}

const std::map<std::string, Conversion>& Conversions() {
  static const std::map<std::string, Conversion> conversions = {
      {"GetTitlesResponse", Of(soap_new_VL1__GetTitlesResponse, VLUtilities::VL1__GetTitlesResponse2VL_WS_TitlesResponse)},
      {"ArrayOfGetTitlesResponse",
       Of(soap_new_VL1__ArrayOfGetTitlesResponse, VLUtilities::VL1__ArrayOfGetTitlesResponse2VL_WS_TitlesResponseArray)},
      {"ArrayOfTitleListingResponse", Of(soap_new_VL1__ArrayOfTitleListingResponse,
                                         VLUtilities::VL1__ArrayOfTitleListingResponse2VL_WS_TitleListingResponseArray)},
      {"ArrayOfGenre", Of(soap_new_VL1__ArrayOfGenre, VLUtilities::VL1__ArrayOfGenre2VL_WS_GenreArray)},
      {"TvEpisodeList", Of(soap_new_VL1__TvEpisodeList, VLUtilities::VL1__TvEpisodeList2VL_WS_TvEpisodeListResponse)},
      {"GetWishlistItemsResponse",
       Of(soap_new_VL1__GetWishlistItemsResponse, VLUtilities::VL1__GetWishlistItemsResponse2VL_WS_WishlistItemsResponse)},
      {"ArrayOfTitleListingPurchasedForPass",
       Of(soap_new_VL1__ArrayOfTitleListingPurchasedForPass,
          VLUtilities::VL1__ArrayOfTitleListingPurchasedForPass2VL_WS_TitleListingPurchasedForPassArray)},
      {"AuthorizeDeviceResponse",
       Of(soap_new_VL1__AuthorizeDeviceResponse, VLUtilities::VL1__AuthorizeDeviceResponse2VL_WS_AuthorizeDeviceResponse)},
      {"GetStreamingAssetLocationResponse",
       Of(soap_new_VL1__GetStreamingAssetLocationResponse,
          VLUtilities::VL1__GetStreamingAssetLocationResponse2VL_WS_StreamingAssetLocationResponse)},
  };
  return conversions;
}

TEST(Convert, EveryCaseGivesItsRecord) {
  soap* context = soap_new();
  soap_set_namespaces(context, namespaces);
  std::istringstream lines(VLReadFile(VL_SOURCE_DIR "/tests/data/convert.txt"));
  std::string transcript;
  for (std::string line; std::getline(lines, line);) {
    if (line.compare(0, 2, "< ") == 0) {
      size_t space = line.find(' ', 2);
      auto conversion = Conversions().find(line.substr(2, space - 2));
      transcript += line + "\n" + (conversion == Conversions().end() || space == std::string::npos
                                       ? "unknown type\n"
                                       : conversion->second(context, line.substr(space + 1)));
    } else if (line.empty() || line[0] == '#') {
      transcript += line + "\n";
    }
  }
  soap_destroy(context);
  soap_end(context);
  soap_free(context);
  VLExpectTranscript("convert.txt", transcript);
}

}  // namespace
