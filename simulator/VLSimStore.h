// VLSimStore: what changes while the simulator runs — device authorisations and their tokens,
// wishlists, purchases and the passes they create, streams, gift certificates, balances — and
// the knobs a test turns (clock, catalogue load time, device environments, access type,
// configuration items, box-art versions). Every method locks the store, so connection threads
// and tests may call it at any time; each business rule is one call, so a check and its change
// (enough balance, then pay) happen under one lock.
//
// Response codes are the ones the simulated store answers; VLSimResponseCodes lists them.
#ifndef VLSIMSTORE_H
#define VLSIMSTORE_H

#include <time.h>

#include <map>
#include <mutex>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "VLSimCatalogue.h"

// The store's response codes (0 is success everywhere).
namespace VLSimCode {
const int kNotAuthorised = 1;       // missing, unknown or revoked token (most account operations)
const int kUnknownItem = 2;         // unknown title, genre, SKU, pass, stream, bonus asset ...
const int kBadRequest = 3;          // a required field missing or out of range
// authorizeDevice
const int kWrongPin = 1;
const int kDeviceLimit = 2;
// doPurchaseSavedbilling
const int kPurchaseUnknownSku = 2;
const int kAlreadyOwned = 3;
const int kInsufficientBalance = 4;
const int kNoSavedBilling = 5;
const int kNoIPAddress = 6;
// getBillingInfo
const int kNoBillingInfo = 2;
// assignGiftCertificateToUser
const int kUnknownGift = 1;
const int kGiftRedeemed = 2;
const int kGiftNotAuthorised = 3;
// calcOrderTax
const int kTaxUnknownSku = 2;
const int kTaxNoBilling = 3;
// streaming
const int kRentalExpired = 3;
const int kProfileUnavailable = 4;
const int kNoPreviousStream = 5;
const int kNoTHX = 6;
// removeAllMyPurchases
const int kWrongPassword = 2;
// ReturnError
const int kReturnError = 99;
}  // namespace VLSimCode

struct VLSimPass {
  int id = 0;
  int account = 0;
  int sku = 0;
  int title = 0;
  int episode = 0;
  int purchaseType = 0;  // 0 rent, 1 buy
  time_t purchased = 0;
  time_t expires = 0;    // 0: never (a purchase)
  int playStatus = 1;    // VL1__StreamStatus of the last report ("stopped")
  int position = 0;      // seconds, where playback resumes
  std::string lastStream;
};

struct VLSimStream {
  std::string id;
  int pass = 0;   // 0 for a bonus asset
  int bonus = 0;
  int profile = 0;
  int status = 0;
  int startSeconds = 0;
};

struct VLSimStatusReport {
  std::string stream;
  int status = 0;
  int stopSeconds = 0;
};

struct VLSimPurchase {
  int code = 0;
  int pass = 0;
  int transaction = 0;
  std::string authNumber;
};

struct VLSimTax {
  std::string subTotal, tax, total;
};

class VLSimStore {
 public:
  explicit VLSimStore(const VLSimCatalogue& catalogue);

  // ---- Clock (the store's time; rentals expire by it) ----
  time_t Now();
  void SetNow(time_t now);
  void AdvanceClock(long seconds);

  // ---- Devices and tokens ----
  // Authorises the device with an account's PIN: kWrongPin, kDeviceLimit or 0 with a new token.
  int Authorize(const std::string& pin, const std::string& deviceId, int deviceType, std::string* token,
                int* account);
  // The account the token authorises for this device, or 0.
  int AccountForToken(const std::string& token, const std::string& deviceId);
  // Revokes the token; false when it was not valid for the device.
  bool Deactivate(const std::string& token, const std::string& deviceId);
  std::string DeviceName(const std::string& token);
  bool Account(int account, VLSimAccountData* data);
  // The account whose PIN this is (tests use it to find an account), or 0.
  int AccountForPin(const std::string& pin);
  void SetAudioDefault(int account, int profile);
  void SetPrepaidCents(int account, int cents);

  // ---- Wishlist ----
  int WishlistAdd(int account, int title);
  int WishlistRemove(int account, int title);
  void WishlistClear(int account);
  bool InWishlist(int account, int title);
  // Titles in the sort order: 0 last added first, 1 first added first, 2 name A-Z, 3 name Z-A;
  // titleType 1 television only, 2 movies only, else all.
  std::vector<int> Wishlist(int account, int sortOrder, int titleType);

  // ---- Purchases and passes ----
  VLSimPurchase Purchase(int account, int sku, const std::string& ipAddress, bool usePrepaid);
  int OrderTax(int account, int sku, VLSimTax* tax);
  int RedeemGift(int account, const std::string& code, int* balanceCents);
  std::vector<VLSimPass> Passes(int account);
  bool FindPass(int account, int pass, VLSimPass* found);
  // Whether the account holds a pass, not expired, for the title or the SKU.
  bool OwnsTitle(int account, int title);
  bool OwnsSku(int account, int sku);
  // WatchNow (0) while the pass can be played, RentAgain (1) after a rental expired.
  int WatchStatus(const VLSimPass& pass);
  int RemoveAllPurchases(int account, const std::string& password);

  // ---- Streams ----
  int StartStream(int account, int pass, int profile, VLSimStream* stream);
  int LastStream(int account, int pass, VLSimStream* stream);
  int StartBonusStream(int bonus, VLSimStream* stream);
  int ReportStream(int account, const std::string& stream, int status, int stopSeconds);
  std::vector<VLSimStatusReport> StatusReports();

  // ---- Knobs ----
  std::string LastCacheLoadTime();
  void SetLastCacheLoadTime(const std::string& text);
  int DeviceEnv(const std::string& deviceId);
  void SetDeviceEnv(const std::string& deviceId, int digit);
  void SetDefaultEnv(int digit);
  int AccessType();
  void SetAccessType(int type);
  std::vector<std::pair<std::string, std::string>> ConfigItems();
  // Sets (or with an empty value removes) a configuration item.
  void SetConfigItem(const std::string& key, const std::string& value);
  // Version and modification time of a box-art image; TouchBoxArt makes a new version now.
  int BoxArtVersion(const std::string& prefix);
  time_t BoxArtModified(const std::string& prefix);
  void TouchBoxArt(const std::string& prefix);

 private:
  struct Device {
    int account;
    std::string deviceId;
    int deviceType;
  };
  struct WishlistEntry {
    int title;
    long added;  // sequence number
  };

  bool OwnsLocked(int account, int title, int sku);
  VLSimAccountData* AccountLocked(int account);

  const VLSimCatalogue& m_Catalogue;
  std::mutex m_Mutex;
  long m_ClockOffset = 0;
  std::vector<VLSimAccountData> m_Accounts;
  std::map<std::string, Device> m_Tokens;
  int m_NextToken = 1;
  std::map<int, std::vector<WishlistEntry>> m_Wishlists;
  long m_WishlistSequence = 0;
  std::map<int, VLSimPass> m_Passes;
  int m_NextPass = 5001;
  int m_NextTransaction = 700001;
  std::map<std::string, VLSimStream> m_Streams;
  int m_NextStream = 1;
  std::vector<VLSimStatusReport> m_Reports;
  std::set<std::string> m_RedeemedGifts;
  std::string m_LastCacheLoadTime;
  std::map<std::string, int> m_DeviceEnv;
  int m_DefaultEnv = 2;
  int m_AccessType = 2;
  std::vector<std::pair<std::string, std::string>> m_Config;
  std::map<std::string, std::pair<int, time_t>> m_BoxArt;  // prefix -> version, modified
};

#endif  // VLSIMSTORE_H
