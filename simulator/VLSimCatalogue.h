// VLSimCatalogue: the simulator's sample store, read at start from the tab-separated files of a
// data folder (simulator/data/, described in simulator/data/FORMAT.md) and not changed after.
// Everything that changes while the simulator runs (accounts, wishlists, passes) is in VLSimStore.
#ifndef VLSIMCATALOGUE_H
#define VLSIMCATALOGUE_H

#include <map>
#include <string>
#include <utility>
#include <vector>

struct VLSimGenre {
  int id = 0;
  int parent = 0;  // 0: top level
  bool visible = true;
  std::string name;
  std::string labelMessage;
};

struct VLSimProduct {
  int sku = 0;
  int title = 0;
  int episode = 0;       // 0: the whole title
  int purchaseType = 0;  // VL1__StreamAPIPurchaseType: 0 rent, 1 buy
  std::string price;     // decimal text as the store sends it, "3.99"
  int priceCents = 0;
  int rentalHours = 0;   // 0 for purchases
  std::string expireDate;
  std::vector<int> profiles;  // VL1__FileProfile codes
  std::vector<int> audio;     // VL1__AudioProfile codes
};

struct VLSimEpisode {
  int id = 0;
  int title = 0;
  int number = 0;
  std::string name;
  std::vector<int> products;  // SKUs of the episode, in file order
};

struct VLSimBonus {
  int id = 0;
  int title = 0;
  int profile = 0;  // VL1__FileProfile
  int type = 0;     // VL1__BonusAssetType
};

struct VLSimTitle {
  int id = 0;
  bool tv = false;
  std::string name, boxArt;
  std::vector<int> genres;
  std::string mpaa, chvrs, ratingReason;
  int userRating = 0;
  std::string runtime, directors, actors, writers, producers, copyright, tivoId;
  bool thx = false, thxTrailer = false;
  std::string loyaltyBuy, loyaltyRent, synopsis;
  std::vector<int> products;  // SKUs of the whole title, in file order
  std::vector<int> episodes;  // episode IDs in number order
  std::vector<int> bonus;     // bonus asset IDs
};

struct VLSimAccountData {
  int id = 0;
  std::string email, pin, password;
  int deviceLimit = 0;
  std::string ccLastFour;  // empty: no saved card
  int ccTypeId = 0;
  std::string ccType;
  int prepaidCents = 0;
  std::string adultPin;
  bool adultVerification = false;
  int country = 0;
  int audioDefault = 0;  // VL1__AudioProfile
};

class VLSimCatalogue {
 public:
  // Reads every file of the folder; false with "file:line: problem" on the first error.
  bool Load(const std::string& folder, std::string* error);

  const std::vector<VLSimGenre>& Genres() const { return m_Genres; }
  const std::vector<VLSimTitle>& Titles() const { return m_Titles; }
  const std::vector<VLSimAccountData>& Accounts() const { return m_Accounts; }
  const std::vector<std::pair<std::string, int>>& GiftCertificates() const { return m_Gifts; }
  const std::vector<std::pair<std::string, std::string>>& ConfigItems() const { return m_Config; }

  const VLSimGenre* FindGenre(int id) const;
  const VLSimTitle* FindTitle(int id) const;
  const VLSimProduct* FindProduct(int sku) const;
  const VLSimEpisode* FindEpisode(int id) const;
  const VLSimBonus* FindBonus(int id) const;
  const VLSimTitle* FindTivo(const std::string& tivoId) const;
  bool HasBoxArt(const std::string& prefix) const;

  // Titles of the genre and of every genre below it, in catalogue order, each once.
  std::vector<const VLSimTitle*> TitlesInGenre(int genre) const;
  // Titles whose name (detail: also synopsis, actors and directors) contains the query, any
  // letter case.
  std::vector<const VLSimTitle*> Search(const std::string& query, bool detail) const;
  // Up to 10 other titles sharing the title's first genre, then its other genres.
  std::vector<const VLSimTitle*> Recommendations(int title) const;

 private:
  std::vector<VLSimGenre> m_Genres;
  std::vector<VLSimTitle> m_Titles;
  std::map<int, size_t> m_TitleIndex;
  std::map<int, VLSimProduct> m_Products;
  std::map<int, VLSimEpisode> m_Episodes;
  std::map<int, VLSimBonus> m_Bonus;
  std::vector<VLSimAccountData> m_Accounts;
  std::vector<std::pair<std::string, int>> m_Gifts;
  std::vector<std::pair<std::string, std::string>> m_Config;
};

#endif  // VLSIMCATALOGUE_H
