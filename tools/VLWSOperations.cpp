// The operations of vlws: options, the client setup, status texts and the table of operations.
#include "VLWSOperations.h"

#include <errno.h>
#include <limits.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <fstream>
#include <type_traits>
#include <utility>

#include "VLRecordJson.h"

namespace vlws {
namespace {

// ---- Options --------------------------------------------------------------------------------

// An option without a fallback is required unless made Optional.
Option Int(const char* name, const char* help, const char* fallback = nullptr) {
  return {name, Kind::kInt, help, fallback, fallback == nullptr};
}
Option Text(const char* name, const char* help, const char* fallback = nullptr) {
  return {name, Kind::kText, help, fallback, fallback == nullptr};
}
Option IntList(const char* name, const char* help) { return {name, Kind::kIntList, help, nullptr, true}; }
Option Flag(const char* name, const char* help) { return {name, Kind::kFlag, help, nullptr, false}; }
Option Optional(Option option) {
  option.required = false;
  return option;
}

bool ParseInt(const std::string& text, int* value) {
  char* end = nullptr;
  errno = 0;
  long number = strtol(text.c_str(), &end, 10);
  if (text.empty() || *end || errno == ERANGE || number < INT_MIN || number > INT_MAX) return false;
  *value = static_cast<int>(number);
  return true;
}

bool ParseIntList(const std::string& text, std::vector<int>* values) {
  values->clear();
  size_t start = 0;
  for (;;) {
    size_t comma = text.find(',', start);
    int value = 0;
    if (!ParseInt(text.substr(start, comma == std::string::npos ? std::string::npos : comma - start), &value)) {
      return false;
    }
    values->push_back(value);
    if (comma == std::string::npos) return true;
    start = comma + 1;
  }
}

// Whether text is a value of the option's kind; the message says what is wrong.
bool CheckValue(const Option& option, const std::string& text, std::string* error) {
  int number = 0;
  std::vector<int> numbers;
  if (option.kind == Kind::kInt && !ParseInt(text, &number)) {
    *error = std::string("--") + option.name + " needs a whole number, not \"" + text + "\"";
    return false;
  }
  if (option.kind == Kind::kIntList && !ParseIntList(text, &numbers)) {
    *error = std::string("--") + option.name + " needs whole numbers separated by commas, not \"" + text + "\"";
    return false;
  }
  return true;
}

// A call of the table asked for an option its row does not declare, or one without a value:
// a fault of the table, which the test of every operation finds.
[[noreturn]] void Fail(const char* name) {
  fprintf(stderr, "vlws: internal error: option --%s has no value\n", name);
  abort();
}

}  // namespace

const char* Placeholder(Kind kind) {
  switch (kind) {
    case Kind::kInt: return " N";
    case Kind::kText: return " TEXT";
    case Kind::kIntList: return " N,N,...";
    case Kind::kFlag: break;
  }
  return "";
}

const char* Args::Text(const char* name) const {
  auto found = m_Values.find(name);
  return found == m_Values.end() ? nullptr : found->second.c_str();
}

int Args::Int(const char* name) const {
  int value = 0;
  if (!ParseInt(Value(name), &value)) Fail(name);
  return value;
}

std::vector<int> Args::Ints(const char* name) const {
  std::vector<int> values;
  if (!ParseIntList(Value(name), &values)) Fail(name);
  return values;
}

const std::string& Args::Value(const char* name) const {
  auto found = m_Values.find(name);
  if (found == m_Values.end()) Fail(name);
  return found->second;
}

// ---- Client setup -----------------------------------------------------------------------------

const std::vector<Option>& SetupOptions() {
  static const std::vector<Option> options = {
      Optional(Text("settings", "a file of \"name = value\" lines (names of the options below; lines starting "
                                "with '#' are comments); an option given on the command line wins")),
      Text("api-key", "the application's API key (APIKey)"),
      Text("user-name", "WS-Security user name (UserName)"),
      Text("password", "WS-Security password (Password)"),
      Text("device-id", "the device's identifier (DestinationUniqueID), e.g. 00-11-22-33-44-55; "
                        "vlws device-id prints this machine's"),
      Int("device-type", "the device type number (DestinationTypeID)", "0"),
      Optional(Text("token", "the account's token (AuthToken), as authorize prints it")),
      Int("env", "environment (EnvNum): 0 stgapi, 1 stg, 2 production, 3 ask the store", "2"),
      Int("content-type", "catalogue (ContentType): 0 general, 1 adult", "0"),
      Int("access-type", "AccessType: 0 ask the store, 1 download, 2 stream", "0"),
      Int("cache-type", "CacheType: 0 none, 1 in memory (this run only), 2 a file in --cache-path", "0"),
      Int("cache-data", "what is cached (CacheData bits): 1 catalogue, 2 box art, 4 user data", "7"),
      Int("cache-limit", "cache size limit in bytes (CacheLimit): 0 none, else at least 358400", "0"),
      Optional(Text("cache-path", "folder of the cache file and images (CachePath); needed with --cache-type 2")),
      Optional(Text("proxy-host", "HTTP proxy host (ProxyHost)")),
      Int("proxy-port", "HTTP proxy port (ProxyPort)", "0"),
      Optional(Text("proxy-user", "proxy user name (ProxyUserName)")),
      Optional(Text("proxy-password", "proxy password (ProxyPassword)")),
      Optional(Text("app-revision", "ApplicationRevision, part of the User-Agent")),
      Optional(Text("firmware-version", "firmwareVersion, part of the User-Agent")),
      Optional(Text("model-number", "modelNumber, part of the User-Agent")),
  };
  return options;
}

// The setup record of the options; its texts point into args.
VL_WS_SetupParams SetupParams(const Args& args) {
  VL_WS_SetupParams params = {};
  params.APIKey = args.Text("api-key");
  params.AuthToken = args.Text("token");
  params.DestinationUniqueID = args.Text("device-id");
  params.DestinationTypeID = args.Int("device-type");
  params.UserName = args.Text("user-name");
  params.Password = args.Text("password");
  params.ContentType = static_cast<enum VL_WS_SetupParams::ContentType>(args.Int("content-type"));
  params.EnvNum = static_cast<VL_WS_EnvNum>(args.Int("env"));
  params.CacheType = args.Int("cache-type");
  params.CacheData = static_cast<VL_WS_CacheParam::CacheData>(args.Int("cache-data"));
  params.CacheLimit = static_cast<unsigned int>(args.Int("cache-limit"));
  params.CachePath = args.Text("cache-path");
  params.ProxyHost = args.Text("proxy-host");
  params.ProxyPort = args.Int("proxy-port");
  params.ProxyUserName = args.Text("proxy-user");
  params.ProxyPassword = args.Text("proxy-password");
  params.AccessType = static_cast<VL_WS_AccessType>(args.Int("access-type"));
  params.ApplicationRevision = args.Text("app-revision");
  params.firmwareVersion = args.Text("firmware-version");
  params.modelNumber = args.Text("model-number");
  return params;
}

namespace {

const Option* FindOption(const std::vector<Option>& options, const std::string& name) {
  for (const Option& option : options) {
    if (name == option.name) return &option;
  }
  return nullptr;
}

std::string Trim(const std::string& text) {
  size_t begin = text.find_first_not_of(" \t\r");
  if (begin == std::string::npos) return "";
  return text.substr(begin, text.find_last_not_of(" \t\r") - begin + 1);
}

// Sets the setup options that the settings file gives and the command line does not.
bool ReadSettingsFile(const std::string& path, Args* args, std::string* error) {
  std::ifstream in(path);
  if (!in) {
    *error = "cannot read the settings file " + path;
    return false;
  }
  std::string line;
  for (int number = 1; std::getline(in, line); ++number) {
    std::string where = path + ":" + std::to_string(number) + ": ";
    line = Trim(line);
    if (line.empty() || line[0] == '#') continue;  // a value may hold '#', as a password may
    size_t equals = line.find('=');
    std::string name = Trim(line.substr(0, equals));
    const Option* option = FindOption(SetupOptions(), name);
    if (equals == std::string::npos || !option || name == "settings") {
      *error = where + "expected \"name = value\" with the name of a setup option, not \"" + line + "\"";
      return false;
    }
    std::string value = Trim(line.substr(equals + 1));
    if (!CheckValue(*option, value, error)) {
      *error = where + *error;
      return false;
    }
    if (!args->Has(name)) args->Set(name, value);
  }
  return true;
}

// ---- Statuses ---------------------------------------------------------------------------------

#define VLWS_STATUS(status) status, #status

struct StatusText {
  VL_WS_Status status;
  const char* name;
  const char* meaning;
};

const StatusText kStatuses[] = {
    {VLWS_STATUS(VL_WS_E_INVALID_ARGUMENT), "an argument is missing, empty or out of range"},
    {VLWS_STATUS(VL_WS_E_NETWORK), "a network step failed: a host name not resolved, no connection, nothing "
                                   "received, or an HTTP answer of the wrong form"},
    {VLWS_STATUS(VL_WS_E_UNEXPECTED), "an unexpected result: the store's response code is a failure for this "
                                      "operation, or its answer could not be read"},
    {VLWS_STATUS(VL_WS_E_FILE), "a local file operation failed"},
    {VLWS_STATUS(VL_WS_E_HTTP_NOT_FOUND), "the server answered \"404 Not Found\""},
    {VLWS_STATUS(VL_WS_E_HTTP_NOT_MODIFIED), "the image server answered \"304 Not Modified\""},
    {VLWS_STATUS(VL_WS_E_SETTING_MISSING), "the settings file is empty or has no setting with the key"},
    {VLWS_STATUS(VL_WS_E_SETTING_DAMAGED), "the encrypted value is damaged"},
    {VLWS_STATUS(VL_WS_E_SETTING_UNREADABLE), "the file does not parse as a settings file"},
    {VLWS_STATUS(VL_WS_E_CACHE_OPEN), "the cache database could not be opened"},
    {VLWS_STATUS(VL_WS_E_CACHE_FOLDER), "the cache folder does not exist and cannot be created"},
    {VLWS_STATUS(VL_WS_E_BANDWIDTH_NO_URL), "the store's configuration names no bandwidth probe"},
    {VLWS_STATUS(VL_WS_E_BANDWIDTH_BAD_URL), "the bandwidth probe's URL has no host or no path"},
    {VLWS_STATUS(VL_WS_E_CONNECT), "the store could not be reached (VLWS_CONNECT_TO directs the client to a "
                                   "lab store or the simulator)"},
    {VLWS_STATUS(VL_WS_E_EOF), "the connection ended before the answer was complete"},
    {VLWS_STATUS(VL_WS_E_TLS_SETUP), "the TLS set-up failed"},
    {VLWS_STATUS(VL_WS_E_TLS), "TLS failed (SSL_CERT_FILE adds the CA of a lab store)"},
};

// Statuses that stand for a response code of the store, named for the operation that returns them
// (some numbers have a name for each of two operations).
struct ResponseCodeStatus {
  const char* function;
  VL_WS_Status status;
  const char* name;
};

const ResponseCodeStatus kResponseCodeStatuses[] = {
    {"VL_WS_authorizeDevice", VLWS_STATUS(VL_WS_E_AUTHORIZE_1)},
    {"VL_WS_authorizeDevice", VLWS_STATUS(VL_WS_E_AUTHORIZE_2)},
    {"VL_WS_doPurchaseSavedBilling", VLWS_STATUS(VL_WS_E_PURCHASE_1)},
    {"VL_WS_doPurchaseSavedBilling", VLWS_STATUS(VL_WS_E_PURCHASE_2)},
    {"VL_WS_doPurchaseSavedBilling", VLWS_STATUS(VL_WS_E_PURCHASE_3)},
    {"VL_WS_doPurchaseSavedBilling", VLWS_STATUS(VL_WS_E_PURCHASE_4)},
    {"VL_WS_doPurchaseSavedBilling", VLWS_STATUS(VL_WS_E_PURCHASE_5)},
    {"VL_WS_doPurchaseSavedBilling", VLWS_STATUS(VL_WS_E_PURCHASE_6)},
    {"VL_WS_doPurchaseSavedBilling", VLWS_STATUS(VL_WS_E_PURCHASE_7)},
    {"VL_WS_doPurchaseSavedBilling", VLWS_STATUS(VL_WS_E_PURCHASE_8)},
    {"VL_WS_doPurchaseSavedBilling", VLWS_STATUS(VL_WS_E_PURCHASE_9)},
    {"VL_WS_doPurchaseSavedBilling", VLWS_STATUS(VL_WS_E_PURCHASE_10)},
    {"VL_WS_doPurchaseSavedBilling", VLWS_STATUS(VL_WS_E_PURCHASE_11)},
    {"VL_WS_doPurchaseSavedBilling", VLWS_STATUS(VL_WS_E_PURCHASE_12)},
    {"VL_WS_doPurchaseSavedBilling", VLWS_STATUS(VL_WS_E_PURCHASE_20)},
    {"VL_WS_doPurchaseSavedBilling", VLWS_STATUS(VL_WS_E_PURCHASE_21)},
    {"VL_WS_doPurchaseSavedBilling", VLWS_STATUS(VL_WS_E_PURCHASE_22)},
    {"VL_WS_getBillingInfo", VLWS_STATUS(VL_WS_E_BILLING_INFO_1)},
    {"VL_WS_getBillingInfo", VLWS_STATUS(VL_WS_E_BILLING_INFO_2)},
    {"VL_WS_getBillingInfo", VLWS_STATUS(VL_WS_E_BILLING_INFO_3)},
    {"VL_WS_getBillingInfo", VLWS_STATUS(VL_WS_E_BILLING_INFO_4)},
    {"VL_WS_assignGiftCertificateToUser", VLWS_STATUS(VL_WS_E_GIFT_CERTIFICATE_1)},
    {"VL_WS_assignGiftCertificateToUser", VLWS_STATUS(VL_WS_E_GIFT_CERTIFICATE_2)},
    {"VL_WS_calcOrderTax", VLWS_STATUS(VL_WS_E_ORDER_TAX_1)},
    {"VL_WS_calcOrderTax", VLWS_STATUS(VL_WS_E_ORDER_TAX_2)},
    {"VL_WS_calcOrderTax", VLWS_STATUS(VL_WS_E_ORDER_TAX_3)},
    {"VL_WS_calcOrderTax", VLWS_STATUS(VL_WS_E_ORDER_TAX_11)},
    {"VL_WS_calcOrderTax", VLWS_STATUS(VL_WS_E_ORDER_TAX_12)},
    {"VL_WS_calcOrderTax", VLWS_STATUS(VL_WS_E_ORDER_TAX_20)},
};

#undef VLWS_STATUS

}  // namespace

std::string DescribeStatus(VL_WS_Status status, const char* function) {
  std::string number = " (" + std::to_string(status) + "): ";
  for (const ResponseCodeStatus& row : kResponseCodeStatuses) {
    if (row.status == status && strcmp(function, row.function) == 0) {
      return row.name + number + "the store refused the request";  // its code and message follow
    }
  }
  for (const StatusText& row : kStatuses) {
    if (row.status == status) return row.name + number + row.meaning;
  }
  if (status <= VL_WS_E_SOAP && status > VL_WS_E_SOAP - 100) {
    int error = VL_WS_E_SOAP - status;
    std::string what = error == 1   ? "a client fault"
                       : error == 2 ? "a fault of the store"
                                    : "SOAP runtime error " + std::to_string(error);
    return "VL_WS_E_SOAP_FAULT(" + std::to_string(error) + ")" + number + "the SOAP exchange failed (" + what + ")";
  }
  if (status <= VL_WS_E_HTTP && status > VL_WS_E_HTTP - 600) {
    int error = VL_WS_E_HTTP - status;
    return "VL_WS_E_HTTP_STATUS(" + std::to_string(error) + ")" + number + "the HTTP exchange failed" +
           (error >= 100 ? " with HTTP status " + std::to_string(error) : "");
  }
  return "status" + number + "not a status of the interface";
}

// ---- Operations -------------------------------------------------------------------------------

namespace {

// What an operation that fills nothing writes: an empty object.
struct NoResult {};

// A call of the table is a lambda (const Args&, VL_WS_Handle*, Result*) with a handle, or
// (const Args&, Result*) without one; CallOf reads which.
template <class Call>
struct CallOf : CallOf<decltype(&Call::operator())> {};
template <class Lambda, class Result>
struct CallOf<VL_WS_Status (Lambda::*)(const Args&, VL_WS_Handle*, Result*) const> {
  typedef Result Type;
  static const bool kHandle = true;
};
template <class Lambda, class Result>
struct CallOf<VL_WS_Status (Lambda::*)(const Args&, Result*) const> {
  typedef Result Type;
  static const bool kHandle = false;
};

// Records carry a tag and are given back with VL_WS_release; the environment list and plain
// results do not.
template <class R, class = void>
struct IsTagged : std::false_type {};
template <class R>
struct IsTagged<R, std::void_t<decltype(std::declval<R&>().tag)>> : std::true_type {};

template <class R, class = void>
struct HasResponseCode : std::false_type {};
template <class R>
struct HasResponseCode<R, std::void_t<decltype(std::declval<R&>().ResponseCode)>> : std::true_type {};

template <class R>
void WriteResult(VLJsonWriter* json, const char* key, const R& result) {
  if constexpr (std::is_same_v<R, NoResult>) {
    json->BeginObject();
    json->EndObject();
  } else if constexpr (std::is_arithmetic_v<R>) {
    json->BeginObject();
    json->Key(key);
    if constexpr (std::is_same_v<R, bool>) json->Bool(result); else json->Int(result);
    json->EndObject();
  } else {
    VLJsonValue(*json, result);
  }
}

// A row of the table. key names the value of a plain result (bool, int, ...), written as
// {"key": value}; records are written by VLJsonValue.
template <class Call>
Operation Op(const char* name, const char* function, const char* summary, std::vector<Option> options,
             const char* key, Call call) {
  typedef CallOf<Call> Of;
  typedef typename Of::Type Result;
  auto run = [call, key](const Args& args, VL_WS_Handle* handle, VLJsonWriter* json, std::string* detail) {
    Result result{};
    VL_WS_Status status;
    if constexpr (Of::kHandle) status = call(args, handle, &result); else status = call(args, &result);
    WriteResult(json, key, result);
    if constexpr (HasResponseCode<Result>::value) {
      if (status != VL_WS_OK && result.ResponseCode != 0) {
        *detail = "response code " + std::to_string(result.ResponseCode) + ": \"" +
                  (result.ResponseMessage ? result.ResponseMessage : "") + "\"";
      }
    }
    if constexpr (IsTagged<Result>::value) VL_WS_release(&result);
    return status;
  };
  return {name, function, summary, std::move(options), Of::kHandle, run};
}

// A row whose call fills a record (or nothing).
template <class Call>
Operation Op(const char* name, const char* function, const char* summary, std::vector<Option> options, Call call) {
  static_assert(!std::is_arithmetic_v<typename CallOf<Call>::Type>, "a plain result needs the key of its value");
  return Op(name, function, summary, std::move(options), nullptr, call);
}

typedef VL_WS_Handle* H;
typedef const Args& A;

}  // namespace

const std::vector<Operation>& Operations() {
  const Option title = Int("title", "title ID");
  const Option sku = Int("sku", "product ID (SkuID)");
  const Option pass = Int("pass", "pass ID (PassID of a purchase or of my-videos)");
  const Option bonus = Int("bonus", "bonus asset ID");
  const Option profile = Int("profile", "file profile, the store's number");
  const Option page = Int("page", "page number, from 1", "1");
  const Option items = Int("items", "items per page", "20");
  const Option purchaseType = Int("purchase-type", "0 rent, 1 buy, 2 any", "2");
  const Option titleType = Int("title-type", "0 all, 1 television, 2 movies", "0");
  const Option size = Int("size", "image size: 0 = 95, 1 = 175, 2 = 65, 3 = 77, 4 = 102, 5 = 126, 6 = 135s, "
                                  "7 = 137, 8 = 153, 9 = 177, 10 = 203, 11 = 269, 12 = 321");
  const Option prefix = Text("prefix", "the title's BoxArtPrefix");
  const Option query = Text("query", "the text to search for");
  const Option file = Text("file", "the file's path");
  const Option path = Text("path", "the path");
  const Option source = Text("source", "the file to copy");
  const Option destination = Text("destination", "where the copy goes");
  const Option key = Text("key", "the setting's key");
  const Option encrypted = Flag("encrypted", "the value is stored encrypted");

  static const std::vector<Operation> operations = {
      // Handles and environments
      Op("version", "VL_WS_getVersion", "the interface's version", {},
         [](A, VL_WS_Version* r) { return VL_WS_getVersion(r); }),
      Op("env-list", "VL_WS_getAvailableEnvLists", "the environments a client can be made for", {},
         [](A, VL_WS_EnvList* r) { return VL_WS_getAvailableEnvLists(r); }),
      Op("default-env", "VL_WS_getDefaultEnvID", "the environment the store's device-environment service names "
         "for this device", {}, "envID", [](A, H h, VL_WS_EnvID* r) { return VL_WS_getDefaultEnvID(h, r); }),
      Op("device-env", "VL_WS_getDeviceEnv", "the environment the client works in", {}, "envID",
         [](A, H h, VL_WS_EnvID* r) { return VL_WS_getDeviceEnv(h, r); }),

      // Account
      Op("file-type", "VL_WS_getFileType", "the store's file type for this device", {},
         [](A, H h, VL_WS_FileType* r) { return VL_WS_getFileType(h, r); }),
      Op("authorize", "VL_WS_authorizeDevice", "link the device to the account whose PIN this is; prints the "
         "account's AuthToken, which later runs take as --token", {Int("pin", "the account's PIN")},
         [](A a, H h, VL_WS_AuthorizeDeviceResponse* r) { return VL_WS_authorizeDevice(h, a.Int("pin"), r); }),
      Op("deactivate", "VL_WS_deactivateDevice", "unlink the device from its account", {},
         [](A, H h, VL_WS_StandardResponse* r) { return VL_WS_deactivateDevice(h, r); }),
      Op("check-token", "VL_WS_checkAuthToken", "whether the store accepts the token", {}, "valid",
         [](A, H h, bool* r) { return VL_WS_checkAuthToken(h, r); }),
      Op("email", "VL_WS_getEmailAddress", "the account's e-mail address", {},
         [](A, H h, VL_WS_EmailAddressResponse* r) { return VL_WS_getEmailAddress(h, r); }),
      Op("settings-page", "VL_WS_getSettingsPageInfo", "the account and the device's name", {},
         [](A, H h, VL_WS_SettingsPageResponse* r) { return VL_WS_getSettingsPageInfo(h, r); }),
      Op("config", "VL_WS_getConfig", "the store's configuration for the device", {},
         [](A, H h, VL_WS_ConfigResponse* r) { return VL_WS_getConfig(h, r); }),
      Op("country", "VL_WS_getCountryID", "the store's number of the account's country", {}, "countryID",
         [](A, H h, int* r) { return VL_WS_getCountryID(h, r); }),
      Op("adult-verification", "VL_WS_checkAdultVerificationEnabled", "whether adult titles need the "
         "adult-content PIN", {},
         [](A, H h, VL_WS_AdultVerificationEnabledResponse* r) { return VL_WS_checkAdultVerificationEnabled(h, r); }),
      Op("adult-pin", "VL_WS_checkAdultVerificationPin", "whether this is the account's adult-content PIN",
         {Int("pin", "the PIN, sent as at least four digits")},
         [](A a, H h, VL_WS_AdultVerificationPinResponse* r) {
           return VL_WS_checkAdultVerificationPin(h, a.Int("pin"), r);
         }),
      Op("return-error", "VL_WS_returnError", "test operation: the store answers with an error code", {},
         [](A, H h, VL_WS_StandardResponse* r) { return VL_WS_returnError(h, r); }),
      Op("return-timeout", "VL_WS_returnTimeout", "test operation: the store holds its answer past the "
         "client's receive time-out", {},
         [](A, H h, VL_WS_StandardResponse* r) { return VL_WS_returnTimeout(h, r); }),

      // Purchases and billing
      Op("purchase", "VL_WS_doPurchaseSavedBilling", "buy or rent a product with the saved card or the "
         "prepaid funds; prints the new PassID",
         {sku, Text("ip-address", "the client's IP address"), Flag("prepaid", "pay with the prepaid funds")},
         [](A a, H h, VL_WS_PurchaseResponse* r) {
           return VL_WS_doPurchaseSavedBilling(h, a.Int("sku"), a.Text("ip-address"), a.Flag("prepaid"), r);
         }),
      Op("order-tax", "VL_WS_calcOrderTax", "sub-total, tax and total of buying a product", {sku},
         [](A a, H h, VL_WS_OrderTaxResponse* r) { return VL_WS_calcOrderTax(h, a.Int("sku"), r); }),
      Op("billing-info", "VL_WS_getBillingInfo", "the account's saved card", {},
         [](A, H h, VL_WS_BillingInfoResponse* r) { return VL_WS_getBillingInfo(h, r); }),
      Op("billing-and-balance", "VL_WS_getBillingInfoAndPPCBalance", "the saved card and the prepaid balance", {},
         [](A, H h, VL_WS_BillingInfoAndPPCBalance* r) { return VL_WS_getBillingInfoAndPPCBalance(h, r); }),
      Op("prepaid-balance", "VL_WS_getPrePaidCardBalance", "the account's prepaid balance", {},
         [](A, H h, VL_WS_PrePaidCardBalanceResponse* r) { return VL_WS_getPrePaidCardBalance(h, r); }),
      Op("redeem-gift", "VL_WS_assignGiftCertificateToUser", "redeem a gift certificate for the account",
         {Text("code", "the gift certificate's code")},
         [](A a, H h, VL_WS_GiftCertificateResponse* r) {
           return VL_WS_assignGiftCertificateToUser(h, a.Text("code"), r);
         }),
      Op("my-videos", "VL_WS_getMyVideos", "one page of the account's bought and rented titles",
         {page, items, purchaseType, titleType,
          Int("watch-status", "0 watch now, 1 rent again, 2 not available, 3 any", "3")},
         [](A a, H h, VL_WS_MyVideosResponse* r) {
           return VL_WS_getMyVideos(h, a.Int("page"), a.Int("items"), a.Int("purchase-type"), a.Int("title-type"),
                                    a.Int("watch-status"), r);
         }),
      Op("rental-expiration", "VL_WS_checkRentalExpiration", "whether to warn that a rental runs out", {pass},
         [](A a, H h, VL_WS_RentalExpirationResponse* r) { return VL_WS_checkRentalExpiration(h, a.Int("pass"), r); }),
      Op("purchased-title", "VL_WS_checkForPurchasedTitle", "whether the account holds a pass for a title",
         {title}, "purchased", [](A a, H h, bool* r) { return VL_WS_checkForPurchasedTitle(h, a.Int("title"), r); }),
      Op("purchased-sku", "VL_WS_checkForPurchasedSku", "whether the account holds a pass for a product", {sku},
         "purchased", [](A a, H h, bool* r) { return VL_WS_checkForPurchasedSku(h, a.Int("sku"), r); }),
      Op("remove-all-purchases", "VL_WS_removeAllMyPurchases", "delete every pass of the account",
         {Text("account-password", "the account's password")},
         [](A a, H h, VL_WS_StandardResponse* r) {
           return VL_WS_removeAllMyPurchases(h, a.Text("account-password"), r);
         }),
      Op("purchased-listings", "VL_WS_getTitleListingPurchaseds", "the purchased title of each pass",
         {IntList("passes", "pass IDs")},
         [](A a, H h, VL_WS_TitleListingPurchasedForPassArray* r) {
           std::vector<int> passes = a.Ints("passes");
           return VL_WS_getTitleListingPurchaseds(h, static_cast<int>(passes.size()), passes.data(), r);
         }),

      // Wishlist
      Op("wishlist", "VL_WS_getWishlistItems", "one page of the wishlist",
         {Int("sort", "0 last added first, 1 first added first, 2 name A-Z, 3 name Z-A", "0"), page, items,
          titleType},
         [](A a, H h, VL_WS_WishlistItemsResponse* r) {
           return VL_WS_getWishlistItems(h, static_cast<VL_WS_SortOrder>(a.Int("sort")), a.Int("page"),
                                         a.Int("items"), a.Int("title-type"), r);
         }),
      Op("wishlist-add", "VL_WS_addItemToWishlist", "put a title on the wishlist", {title},
         [](A a, H h, VL_WS_StandardResponse* r) { return VL_WS_addItemToWishlist(h, a.Int("title"), r); }),
      Op("wishlist-remove", "VL_WS_removeItemFromWishlist", "take a title off the wishlist", {title},
         [](A a, H h, VL_WS_StandardResponse* r) { return VL_WS_removeItemFromWishlist(h, a.Int("title"), r); }),
      Op("wishlist-clear", "VL_WS_removeAllItemsFromWishlist", "empty the wishlist", {},
         [](A, H h, VL_WS_StandardResponse* r) { return VL_WS_removeAllItemsFromWishlist(h, r); }),
      Op("in-wishlist", "VL_WS_checkTitleInWishlist", "whether a title is on the wishlist", {title}, "inWishlist",
         [](A a, H h, bool* r) { return VL_WS_checkTitleInWishlist(h, a.Int("title"), r); }),
      Op("in-wishlist-titles", "VL_WS_checkTitlesInWishlist", "for each title, whether it is on the wishlist",
         {IntList("titles", "title IDs"), titleType},
         [](A a, H h, VL_WS_BoolArray* r) {
           std::vector<int> titles = a.Ints("titles");
           return VL_WS_checkTitlesInWishlist(h, static_cast<int>(titles.size()), titles.data(),
                                              a.Int("title-type"), r);
         }),

      // Streaming
      Op("stream", "VL_WS_getStreamingAssetLocation", "where a pass streams from: a new stream instance",
         {pass, profile},
         [](A a, H h, VL_WS_StreamingAssetLocationResponse* r) {
           return VL_WS_getStreamingAssetLocation(h, a.Int("pass"), a.Int("profile"), r);
         }),
      Op("bonus-stream", "VL_WS_getStreamingBonusAssetLocation", "where a bonus asset streams from", {bonus},
         [](A a, H h, VL_WS_StreamingAssetLocationResponse* r) {
           return VL_WS_getStreamingBonusAssetLocation(h, a.Int("bonus"), r);
         }),
      Op("last-stream", "VL_WS_loadLastStreamingAssetLocation", "the last stream instance of a pass",
         {pass, profile},
         [](A a, H h, VL_WS_StreamingAssetLocationResponse* r) {
           return VL_WS_loadLastStreamingAssetLocation(h, a.Int("pass"), a.Int("profile"), r);
         }),
      Op("stream-status", "VL_WS_manageStreamingInstanceStatus", "report the status of a stream instance",
         {Text("stream-id", "the StreamID of stream or last-stream"),
          Int("status", "0 play, 1 stopped, 2 paused, 3 resume play, 4 error"),
          Int("stop-time", "seconds into the title", "0")},
         [](A a, H h, VL_WS_StandardResponse* r) {
           return VL_WS_manageStreamingInstanceStatus(h, a.Text("stream-id"), a.Int("status"), a.Int("stop-time"), r);
         }),
      Op("thx", "VL_WS_getTHXMediaDirector", "THX media director settings of a pass",
         {pass, profile, Int("audio-profile", "audio profile, the store's number")},
         [](A a, H h, VL_WS_THXMediaDirectorResponse* r) {
           return VL_WS_getTHXMediaDirector(h, a.Int("pass"), a.Int("profile"), a.Int("audio-profile"), r);
         }),
      Op("thx-bonus", "VL_WS_getTHXMediaDirectorBonusAsset", "THX media director settings of a bonus asset",
         {bonus, profile, Int("bonus-type", "bonus asset type: 0 trailer", "0")},
         [](A a, H h, VL_WS_THXMediaDirectorResponse* r) {
           return VL_WS_getTHXMediaDirectorBonusAsset(h, a.Int("bonus"), a.Int("profile"), a.Int("bonus-type"), r);
         }),
      Op("set-audio-default", "VL_WS_setAudioDefaultProperty", "set the account's default audio profile",
         {Int("audio-profile", "audio profile, the store's number")},
         [](A a, H h, VL_WS_StandardResponse* r) { return VL_WS_setAudioDefaultProperty(h, a.Int("audio-profile"), r); }),
      Op("audio-default", "VL_WS_getAudioDefaultProperty", "the account's default audio profile", {},
         "audioProfile", [](A, H h, int* r) { return VL_WS_getAudioDefaultProperty(h, r); }),

      // Catalogue
      Op("navigation", "VL_WS_getNavigation", "the genre tree as a list of genres", {},
         [](A, H h, VL_WS_GenreArray* r) { return VL_WS_getNavigation(h, r); }),
      Op("genre-label", "VL_WS_getGenreLabel", "a genre's label", {Int("genre", "genre ID")},
         [](A a, H h, VL_WS_GenreLabelResponse* r) { return VL_WS_getGenreLabel(h, a.Int("genre"), r); }),
      Op("titles", "VL_WS_getTitles", "one page of the titles of a genre and of the genres below it",
         {Int("genre", "genre ID"), page, items, purchaseType},
         [](A a, H h, VL_WS_TitlesResponse* r) {
           return VL_WS_getTitles(h, a.Int("genre"), a.Int("page"), a.Int("items"), a.Int("purchase-type"), r);
         }),
      Op("titles-by-genres", "VL_WS_getTitlesByGenreIDs", "the same page of each of several genres",
         {IntList("genres", "genre IDs"), page, items, purchaseType},
         [](A a, H h, VL_WS_TitlesResponseArray* r) {
           std::vector<int> genres = a.Ints("genres");
           return VL_WS_getTitlesByGenreIDs(h, static_cast<int>(genres.size()), genres.data(), a.Int("page"),
                                            a.Int("items"), a.Int("purchase-type"), r);
         }),
      Op("title", "VL_WS_getTitleListing", "the details of a title", {title},
         [](A a, H h, VL_WS_TitleListingResponse* r) { return VL_WS_getTitleListing(h, a.Int("title"), r); }),
      Op("episode", "VL_WS_getTvEpisodeListing", "the details of an episode", {Int("episode", "episode ID")},
         [](A a, H h, VL_WS_TitleListingResponse* r) { return VL_WS_getTvEpisodeListing(h, a.Int("episode"), r); }),
      Op("episodes", "VL_WS_getTvEpisodeListByTitleID", "the episodes of a series", {title},
         [](A a, H h, VL_WS_TvEpisodeListResponse* r) { return VL_WS_getTvEpisodeListByTitleID(h, a.Int("title"), r); }),
      Op("episode-listings", "VL_WS_getAllTvEpisodeListings", "the details of every episode of a series", {title},
         [](A a, H h, VL_WS_TitleListingResponseArray* r) {
           return VL_WS_getAllTvEpisodeListings(h, a.Int("title"), r);
         }),
      Op("tivo-title", "VL_WS_translateTivoExternalID", "the title of a TiVo external ID",
         {Text("tivo-id", "the TiVo external ID")},
         [](A a, H h, VL_WS_TranslateTivoExternalIDResponse* r) {
           return VL_WS_translateTivoExternalID(h, a.Text("tivo-id"), r);
         }),
      Op("sku-title", "VL_WS_translateSkuID", "the title of a product", {sku},
         [](A a, H h, VL_WS_TranslateSkuIDResponse* r) { return VL_WS_translateSkuID(h, a.Int("sku"), r); }),
      Op("search", "VL_WS_searchForTitle", "one page of the titles whose name matches",
         {query, page, items, purchaseType, titleType},
         [](A a, H h, VL_WS_TitlesResponse* r) {
           return VL_WS_searchForTitle(h, a.Int("page"), a.Int("items"), a.Int("purchase-type"), a.Int("title-type"),
                                       a.Text("query"), r);
         }),
      Op("search-detail", "VL_WS_searchForTitleDetail", "one page of the titles whose name, synopsis, actors "
         "or directors match", {query, page, items, purchaseType, titleType},
         [](A a, H h, VL_WS_TitlesResponse* r) {
           return VL_WS_searchForTitleDetail(h, a.Int("page"), a.Int("items"), a.Int("purchase-type"),
                                             a.Int("title-type"), a.Text("query"), r);
         }),
      Op("recommended", "VL_WS_getRecommendedTitles", "titles the store recommends with a title", {title},
         [](A a, H h, VL_WS_RecommendedTitlesResponse* r) { return VL_WS_getRecommendedTitles(h, a.Int("title"), r); }),

      // Cache
      Op("cache-load-time", "VL_WS_getLastCacheLoadTimeUTC", "when the store last loaded its catalogue", {},
         [](A, H h, VL_WS_String* r) { return VL_WS_getLastCacheLoadTimeUTC(h, r); }),
      Op("should-update-cache", "VL_WS_shouldUpdateCache", "whether a catalogue load time is out of date",
         {Text("time", "a load time as cache-load-time prints it")}, "update",
         [](A a, H h, bool* r) { return VL_WS_shouldUpdateCache(h, a.Text("time"), r); }),
      Op("update-cache", "VL_WS_updateLocalCache", "refresh kinds of cached data (give a --cache-type)",
         {Int("kinds", "bits: 1 catalogue, 2 box art, 4 user data", "7")},
         [](A a, H h, NoResult*) { return VL_WS_updateLocalCache(h, a.Int("kinds")); }),
      Op("clear-cache", "VL_WS_clearLocalCache", "remove the cache files of a folder",
         {Text("folder", "the cache folder")},
         [](A a, NoResult*) { return VL_WS_clearLocalCache(a.Text("folder")); }),

      // Box art
      Op("boxart", "VL_WS_getBoxArtImage", "where a box-art image can be loaded from (a file with "
         "--cache-type 2, else its URL)", {size, prefix},
         [](A a, H h, VL_WS_String* r) {
           return VL_WS_getBoxArtImage(h, static_cast<VL_WS_BoxArtSize>(a.Int("size")), a.Text("prefix"), r);
         }),
      Op("boxart-data", "VL_WS_getBoxArtImageData", "the bytes of a box-art image (Data in Base64)", {size, prefix},
         [](A a, H h, VL_WS_Image* r) {
           return VL_WS_getBoxArtImageData(h, static_cast<VL_WS_BoxArtSize>(a.Int("size")), a.Text("prefix"), r);
         }),

      // Device and network
      Op("bandwidth", "VL_WS_checkBandwidth", "measure the download bandwidth from the store", {},
         "bitsPerSecond", [](A, H h, unsigned int* r) { return VL_WS_checkBandwidth(h, r); }),
      Op("device-id", "VL_WS_getDestinationUniqueID", "this machine's device identifier", {},
         [](A, VL_WS_String* r) { return VL_WS_getDestinationUniqueID(r); }),
      Op("user-agent", "VL_WS_getUserAgent", "the User-Agent of the client's requests", {},
         [](A, H h, VL_WS_String* r) { return VL_WS_getUserAgent(h, r); }),
      Op("local-ip", "VL_WS_getLocalIPAddr", "the device's IPv4 address", {},
         [](A, H h, VL_WS_String* r) { return VL_WS_getLocalIPAddr(h, r); }),
      Op("server-time", "VL_WS_getServerTime", "the store's clock, seconds since 1970 UTC", {}, "serverTime",
         [](A, time_t* r) { return VL_WS_getServerTime(r); }),

      // Settings files
      Op("read-setting", "VL_WS_readSetting", "a setting of a settings file", {file, key, encrypted},
         [](A a, VL_WS_String* r) {
           return VL_WS_readSetting(a.Text("file"), a.Text("key"), r, a.Flag("encrypted"));
         }),
      Op("write-setting", "VL_WS_writeSetting", "set a setting of a settings file",
         {file, key, Text("value", "the value"), encrypted},
         [](A a, NoResult*) {
           return VL_WS_writeSetting(a.Text("file"), a.Text("key"), a.Text("value"), a.Flag("encrypted"));
         }),
      Op("create-env-xml", "VL_WS_createEnvXML", "copy a file unless the destination exists", {source, destination},
         [](A a, NoResult*) { return VL_WS_createEnvXML(a.Text("source"), a.Text("destination")); }),
      Op("delete-env-xml", "VL_WS_deleteEnvXML", "remove a file if it exists", {file},
         [](A a, NoResult*) { return VL_WS_deleteEnvXML(a.Text("file")); }),

      // Files and folders
      Op("md5sum", "VL_WS_checkVLSWFmd5sum", "the md5sum line of a file", {file},
         [](A a, VL_WS_String* r) { return VL_WS_checkVLSWFmd5sum(a.Text("file"), r); }),
      Op("remove-file", "VL_WS_removeFile", "remove a file", {file},
         [](A a, NoResult*) { return VL_WS_removeFile(a.Text("file")); }),
      Op("copy-file", "VL_WS_copyFile", "copy a file", {source, destination},
         [](A a, NoResult*) { return VL_WS_copyFile(a.Text("source"), a.Text("destination")); }),
      Op("folder-name", "VL_WS_getFolderName", "the folder part of a path", {path},
         [](A a, VL_WS_String* r) { return VL_WS_getFolderName(a.Text("path"), r); }),
      Op("folder-exists", "VL_WS_folderExist", "whether a folder exists", {path}, "exist",
         [](A a, bool* r) { return VL_WS_folderExist(a.Text("path"), r); }),
      Op("create-folder", "VL_WS_createFolder", "create a folder and its missing parents", {path},
         [](A a, NoResult*) { return VL_WS_createFolder(a.Text("path")); }),
      Op("file-exists", "VL_WS_fileExist", "whether a file exists and can be read", {path}, "exist",
         [](A a, bool* r) { return VL_WS_fileExist(a.Text("path"), r); }),
  };
  return operations;
}

// Reads the operation's options (and, for a handle, the setup options and the settings file) and
// applies the fallbacks; the message says what is wrong.
Parsed ParseArgs(const Operation& op, int argc, char** argv, Args* args, std::string* error) {
  for (int i = 0; i < argc; ++i) {
    std::string word = argv[i];
    if (word == "--help" || word == "-h") return Parsed::kHelp;
    if (word.compare(0, 2, "--") != 0) {
      *error = "unexpected argument \"" + word + "\"";
      return Parsed::kError;
    }
    size_t equals = word.find('=');
    std::string name = word.substr(2, equals == std::string::npos ? std::string::npos : equals - 2);
    const Option* option = FindOption(op.options, name);
    if (!option && op.handle) option = FindOption(SetupOptions(), name);
    if (!option) {
      *error = "unknown option --" + name;
      return Parsed::kError;
    }
    std::string value = "1";
    if (option->kind == Kind::kFlag) {
      if (equals != std::string::npos) {
        *error = "--" + name + " takes no value";
        return Parsed::kError;
      }
    } else if (equals != std::string::npos) {
      value = word.substr(equals + 1);
    } else if (i + 1 < argc) {
      value = argv[++i];
    } else {
      *error = "--" + name + " needs a value";
      return Parsed::kError;
    }
    if (!CheckValue(*option, value, error)) return Parsed::kError;
    args->Set(name, value);
  }
  if (args->Has("settings") && !ReadSettingsFile(args->Text("settings"), args, error)) return Parsed::kError;

  std::vector<Option> all = op.options;
  if (op.handle) all.insert(all.end(), SetupOptions().begin(), SetupOptions().end());
  for (const Option& option : all) {
    if (args->Has(option.name)) continue;
    if (option.required) {
      *error = std::string("--") + option.name + " is required";
      return Parsed::kError;
    }
    if (option.fallback) args->Set(option.name, option.fallback);
  }
  if (op.handle && args->Int("cache-type") == 2 && !args->Has("cache-path")) {
    *error = "--cache-type 2 needs --cache-path";
    return Parsed::kError;
  }
  return Parsed::kRun;
}

}  // namespace vlws
