#include "VLSimStore.h"

#include <algorithm>
#include <cstdio>

#include "VLStoreHosts.h"

namespace {

// Box art and catalogue data as loaded: 2011-01-03 10:00:00 UTC.
const time_t kCatalogueLoaded = 1294048800;
const int kTaxPerMille = 75;
const int kHour = 3600;

std::string Decimal(int cents) {
  char text[32];
  snprintf(text, sizeof text, "%d.%02d", cents / 100, cents % 100);
  return text;
}

}  // namespace

VLSimStore::VLSimStore(const VLSimCatalogue& catalogue)
    : m_Catalogue(catalogue),
      m_Accounts(catalogue.Accounts()),
      m_LastCacheLoadTime("2011-01-03T10:00:00"),
      m_Config(catalogue.ConfigItems()) {
  bool hasProbe = std::any_of(m_Config.begin(), m_Config.end(),
                              [](const std::pair<std::string, std::string>& item) { return item.first == "BandwithCheckURL"; });
  if (!hasProbe) m_Config.push_back({"BandwithCheckURL", "http://" VL_STORE_IMAGE_HOST "/speedtest/probe.bin"});
}

// ---- Clock ----

time_t VLSimStore::Now() {
  std::lock_guard<std::mutex> lock(m_Mutex);
  return time(nullptr) + m_ClockOffset;
}

void VLSimStore::SetNow(time_t now) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  m_ClockOffset = static_cast<long>(now - time(nullptr));
}

void VLSimStore::AdvanceClock(long seconds) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  m_ClockOffset += seconds;
}

// ---- Devices and tokens ----

VLSimAccountData* VLSimStore::AccountLocked(int account) {
  for (VLSimAccountData& data : m_Accounts)
    if (data.id == account) return &data;
  return nullptr;
}

int VLSimStore::Authorize(const std::string& pin, const std::string& deviceId, int deviceType,
                          std::string* token, int* account) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  const VLSimAccountData* found = nullptr;
  for (const VLSimAccountData& data : m_Accounts)
    if (!pin.empty() && data.pin == pin) found = &data;
  if (!found) return VLSimCode::kWrongPin;
  // A device that authorises again replaces its old token; other devices count to the limit.
  int devices = 0;
  for (auto it = m_Tokens.begin(); it != m_Tokens.end();) {
    if (it->second.account == found->id && it->second.deviceId == deviceId) {
      it = m_Tokens.erase(it);
      continue;
    }
    if (it->second.account == found->id) ++devices;
    ++it;
  }
  if (devices >= found->deviceLimit) return VLSimCode::kDeviceLimit;
  char text[64];
  snprintf(text, sizeof text, "SIMTOKEN-%d-%04d", found->id, m_NextToken++);
  *token = text;
  *account = found->id;
  m_Tokens[*token] = Device{found->id, deviceId, deviceType};
  return 0;
}

int VLSimStore::AccountForToken(const std::string& token, const std::string& deviceId) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  auto it = m_Tokens.find(token);
  return it != m_Tokens.end() && it->second.deviceId == deviceId ? it->second.account : 0;
}

bool VLSimStore::Deactivate(const std::string& token, const std::string& deviceId) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  auto it = m_Tokens.find(token);
  if (it == m_Tokens.end() || it->second.deviceId != deviceId) return false;
  m_Tokens.erase(it);
  return true;
}

std::string VLSimStore::DeviceName(const std::string& token) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  auto it = m_Tokens.find(token);
  return it == m_Tokens.end() ? std::string() : "Player type " + std::to_string(it->second.deviceType);
}

bool VLSimStore::Account(int account, VLSimAccountData* data) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  const VLSimAccountData* found = AccountLocked(account);
  if (found) *data = *found;
  return found != nullptr;
}

int VLSimStore::AccountForPin(const std::string& pin) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  for (const VLSimAccountData& data : m_Accounts)
    if (data.pin == pin) return data.id;
  return 0;
}

void VLSimStore::SetAudioDefault(int account, int profile) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  if (VLSimAccountData* data = AccountLocked(account)) data->audioDefault = profile;
}

void VLSimStore::SetPrepaidCents(int account, int cents) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  if (VLSimAccountData* data = AccountLocked(account)) data->prepaidCents = cents;
}

// ---- Wishlist ----

int VLSimStore::WishlistAdd(int account, int title) {
  if (!m_Catalogue.FindTitle(title)) return VLSimCode::kUnknownItem;
  std::lock_guard<std::mutex> lock(m_Mutex);
  std::vector<WishlistEntry>& list = m_Wishlists[account];
  if (std::none_of(list.begin(), list.end(), [title](const WishlistEntry& e) { return e.title == title; }))
    list.push_back({title, ++m_WishlistSequence});
  return 0;
}

int VLSimStore::WishlistRemove(int account, int title) {
  if (!m_Catalogue.FindTitle(title)) return VLSimCode::kUnknownItem;
  std::lock_guard<std::mutex> lock(m_Mutex);
  std::vector<WishlistEntry>& list = m_Wishlists[account];
  list.erase(std::remove_if(list.begin(), list.end(), [title](const WishlistEntry& e) { return e.title == title; }),
             list.end());
  return 0;
}

void VLSimStore::WishlistClear(int account) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  m_Wishlists.erase(account);
}

bool VLSimStore::InWishlist(int account, int title) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  const std::vector<WishlistEntry>& list = m_Wishlists[account];
  return std::any_of(list.begin(), list.end(), [title](const WishlistEntry& e) { return e.title == title; });
}

std::vector<int> VLSimStore::Wishlist(int account, int sortOrder, int titleType) {
  std::vector<WishlistEntry> list;
  {
    std::lock_guard<std::mutex> lock(m_Mutex);
    list = m_Wishlists[account];
  }
  auto name = [this](const WishlistEntry& e) { return m_Catalogue.FindTitle(e.title)->name; };
  switch (sortOrder) {
    case 1:
      std::stable_sort(list.begin(), list.end(), [](const WishlistEntry& a, const WishlistEntry& b) { return a.added < b.added; });
      break;
    case 2:
      std::stable_sort(list.begin(), list.end(), [&](const WishlistEntry& a, const WishlistEntry& b) { return name(a) < name(b); });
      break;
    case 3:
      std::stable_sort(list.begin(), list.end(), [&](const WishlistEntry& a, const WishlistEntry& b) { return name(a) > name(b); });
      break;
    default:
      std::stable_sort(list.begin(), list.end(), [](const WishlistEntry& a, const WishlistEntry& b) { return a.added > b.added; });
      break;
  }
  std::vector<int> titles;
  for (const WishlistEntry& entry : list) {
    bool tv = m_Catalogue.FindTitle(entry.title)->tv;
    if (titleType == 1 && !tv) continue;
    if (titleType == 2 && tv) continue;
    titles.push_back(entry.title);
  }
  return titles;
}

// ---- Purchases and passes ----

bool VLSimStore::OwnsLocked(int account, int title, int sku) {
  time_t now = time(nullptr) + m_ClockOffset;
  for (const auto& entry : m_Passes) {
    const VLSimPass& pass = entry.second;
    if (pass.account != account || (pass.expires != 0 && pass.expires <= now)) continue;
    if ((title && pass.title == title) || (sku && pass.sku == sku)) return true;
  }
  return false;
}

VLSimPurchase VLSimStore::Purchase(int account, int sku, const std::string& ipAddress, bool usePrepaid) {
  VLSimPurchase result;
  const VLSimProduct* product = m_Catalogue.FindProduct(sku);
  std::lock_guard<std::mutex> lock(m_Mutex);
  VLSimAccountData* data = AccountLocked(account);
  if (!data) result.code = VLSimCode::kNotAuthorised;
  else if (!product) result.code = VLSimCode::kPurchaseUnknownSku;
  else if (ipAddress.empty()) result.code = VLSimCode::kNoIPAddress;
  else if (OwnsLocked(account, 0, sku)) result.code = VLSimCode::kAlreadyOwned;
  else if (usePrepaid && data->prepaidCents < product->priceCents) result.code = VLSimCode::kInsufficientBalance;
  else if (!usePrepaid && data->ccLastFour.empty()) result.code = VLSimCode::kNoSavedBilling;
  if (result.code) return result;

  if (usePrepaid) data->prepaidCents -= product->priceCents;
  VLSimPass pass;
  pass.id = m_NextPass++;
  pass.account = account;
  pass.sku = sku;
  pass.title = product->title;
  pass.episode = product->episode;
  pass.purchaseType = product->purchaseType;
  pass.purchased = time(nullptr) + m_ClockOffset;
  pass.expires = product->rentalHours ? pass.purchased + product->rentalHours * kHour : 0;
  m_Passes[pass.id] = pass;
  // What was bought leaves the wishlist.
  std::vector<WishlistEntry>& list = m_Wishlists[account];
  list.erase(std::remove_if(list.begin(), list.end(), [&](const WishlistEntry& e) { return e.title == product->title; }),
             list.end());
  result.pass = pass.id;
  result.transaction = m_NextTransaction++;
  char text[32];
  snprintf(text, sizeof text, "AUTH%06d", result.transaction % 1000000);
  result.authNumber = text;
  return result;
}

int VLSimStore::OrderTax(int account, int sku, VLSimTax* tax) {
  const VLSimProduct* product = m_Catalogue.FindProduct(sku);
  std::lock_guard<std::mutex> lock(m_Mutex);
  VLSimAccountData* data = AccountLocked(account);
  if (!data) return VLSimCode::kNotAuthorised;
  if (!product) return VLSimCode::kTaxUnknownSku;
  if (data->ccLastFour.empty()) return VLSimCode::kTaxNoBilling;
  int taxCents = (product->priceCents * kTaxPerMille + 500) / 1000;
  tax->subTotal = product->price;
  tax->tax = Decimal(taxCents);
  tax->total = Decimal(product->priceCents + taxCents);
  return 0;
}

int VLSimStore::RedeemGift(int account, const std::string& code, int* balanceCents) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  VLSimAccountData* data = AccountLocked(account);
  if (!data) return VLSimCode::kGiftNotAuthorised;
  for (const auto& gift : m_Catalogue.GiftCertificates()) {
    if (gift.first != code) continue;
    if (!m_RedeemedGifts.insert(code).second) return VLSimCode::kGiftRedeemed;
    data->prepaidCents += gift.second;
    *balanceCents = data->prepaidCents;
    return 0;
  }
  return VLSimCode::kUnknownGift;
}

std::vector<VLSimPass> VLSimStore::Passes(int account) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  std::vector<VLSimPass> passes;
  for (const auto& entry : m_Passes)
    if (entry.second.account == account) passes.push_back(entry.second);
  return passes;
}

bool VLSimStore::FindPass(int account, int pass, VLSimPass* found) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  auto it = m_Passes.find(pass);
  if (it == m_Passes.end() || it->second.account != account) return false;
  *found = it->second;
  return true;
}

bool VLSimStore::OwnsTitle(int account, int title) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  return OwnsLocked(account, title, 0);
}

bool VLSimStore::OwnsSku(int account, int sku) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  return OwnsLocked(account, 0, sku);
}

int VLSimStore::WatchStatus(const VLSimPass& pass) {
  return pass.expires != 0 && pass.expires <= Now() ? 1 : 0;
}

int VLSimStore::RemoveAllPurchases(int account, const std::string& password) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  VLSimAccountData* data = AccountLocked(account);
  if (!data) return VLSimCode::kNotAuthorised;
  if (data->password != password) return VLSimCode::kWrongPassword;
  for (auto it = m_Passes.begin(); it != m_Passes.end();)
    it = it->second.account == account ? m_Passes.erase(it) : std::next(it);
  return 0;
}

// ---- Streams ----

int VLSimStore::StartStream(int account, int passId, int profile, VLSimStream* stream) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  auto it = m_Passes.find(passId);
  if (it == m_Passes.end() || it->second.account != account) return VLSimCode::kUnknownItem;
  VLSimPass& pass = it->second;
  if (pass.expires != 0 && pass.expires <= time(nullptr) + m_ClockOffset) return VLSimCode::kRentalExpired;
  const std::vector<int>& profiles = m_Catalogue.FindProduct(pass.sku)->profiles;
  if (std::find(profiles.begin(), profiles.end(), profile) == profiles.end()) return VLSimCode::kProfileUnavailable;
  VLSimStream created;
  created.id = "STREAM-" + std::to_string(passId) + "-" + std::to_string(m_NextStream++);
  created.pass = passId;
  created.profile = profile;
  created.status = pass.position > 0 ? 3 : 0;  // resumeplay or play
  created.startSeconds = pass.position;
  m_Streams[created.id] = created;
  pass.lastStream = created.id;
  *stream = created;
  return 0;
}

int VLSimStore::LastStream(int account, int passId, VLSimStream* stream) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  auto it = m_Passes.find(passId);
  if (it == m_Passes.end() || it->second.account != account) return VLSimCode::kUnknownItem;
  if (it->second.lastStream.empty()) return VLSimCode::kNoPreviousStream;
  *stream = m_Streams[it->second.lastStream];
  stream->status = it->second.playStatus;
  stream->startSeconds = it->second.position;
  return 0;
}

int VLSimStore::StartBonusStream(int bonus, VLSimStream* stream) {
  const VLSimBonus* asset = m_Catalogue.FindBonus(bonus);
  if (!asset) return VLSimCode::kUnknownItem;
  std::lock_guard<std::mutex> lock(m_Mutex);
  VLSimStream created;
  created.id = "BONUS-" + std::to_string(bonus) + "-" + std::to_string(m_NextStream++);
  created.bonus = bonus;
  created.profile = asset->profile;
  m_Streams[created.id] = created;
  *stream = created;
  return 0;
}

int VLSimStore::ReportStream(int account, const std::string& streamId, int status, int stopSeconds) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  auto it = m_Streams.find(streamId);
  if (it == m_Streams.end()) return VLSimCode::kUnknownItem;
  if (it->second.pass) {
    auto pass = m_Passes.find(it->second.pass);
    if (pass == m_Passes.end() || pass->second.account != account) return VLSimCode::kUnknownItem;
    pass->second.playStatus = status;
    if (stopSeconds >= 0) pass->second.position = stopSeconds;
  }
  it->second.status = status;
  m_Reports.push_back({streamId, status, stopSeconds});
  return 0;
}

std::vector<VLSimStatusReport> VLSimStore::StatusReports() {
  std::lock_guard<std::mutex> lock(m_Mutex);
  return m_Reports;
}

// ---- Knobs ----

std::string VLSimStore::LastCacheLoadTime() {
  std::lock_guard<std::mutex> lock(m_Mutex);
  return m_LastCacheLoadTime;
}

void VLSimStore::SetLastCacheLoadTime(const std::string& text) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  m_LastCacheLoadTime = text;
}

int VLSimStore::DeviceEnv(const std::string& deviceId) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  auto it = m_DeviceEnv.find(deviceId);
  return it == m_DeviceEnv.end() ? m_DefaultEnv : it->second;
}

void VLSimStore::SetDeviceEnv(const std::string& deviceId, int digit) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  m_DeviceEnv[deviceId] = digit;
}

void VLSimStore::SetDefaultEnv(int digit) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  m_DefaultEnv = digit;
}

int VLSimStore::AccessType() {
  std::lock_guard<std::mutex> lock(m_Mutex);
  return m_AccessType;
}

void VLSimStore::SetAccessType(int type) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  m_AccessType = type;
}

std::vector<std::pair<std::string, std::string>> VLSimStore::ConfigItems() {
  std::lock_guard<std::mutex> lock(m_Mutex);
  return m_Config;
}

void VLSimStore::SetConfigItem(const std::string& key, const std::string& value) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  auto it = std::find_if(m_Config.begin(), m_Config.end(),
                         [&](const std::pair<std::string, std::string>& item) { return item.first == key; });
  if (value.empty()) {
    if (it != m_Config.end()) m_Config.erase(it);
  } else if (it != m_Config.end()) {
    it->second = value;
  } else {
    m_Config.push_back({key, value});
  }
}

int VLSimStore::BoxArtVersion(const std::string& prefix) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  auto it = m_BoxArt.find(prefix);
  return it == m_BoxArt.end() ? 1 : it->second.first;
}

time_t VLSimStore::BoxArtModified(const std::string& prefix) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  auto it = m_BoxArt.find(prefix);
  return it == m_BoxArt.end() ? kCatalogueLoaded : it->second.second;
}

void VLSimStore::TouchBoxArt(const std::string& prefix) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  auto it = m_BoxArt.find(prefix);
  std::pair<int, time_t> entry = it == m_BoxArt.end() ? std::make_pair(1, kCatalogueLoaded) : it->second;
  // A new version is always strictly newer, even within the same second.
  m_BoxArt[prefix] = {entry.first + 1, std::max(entry.second + 1, time(nullptr) + m_ClockOffset)};
}
