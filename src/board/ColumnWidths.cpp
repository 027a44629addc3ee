#include "board/ColumnWidths.h"

#include <algorithm>
#include <numeric>

namespace {

std::vector<int> Shared(int width, const std::vector<double>& shares, const std::vector<int>& least) {
  std::vector<int> widths = least;
  std::vector<bool> getsShare(shares.size(), true);
  for (bool settled = false; !settled;) {
    settled = true;
    double rest = width;
    double restShares = 0;
    for (std::size_t i = 0; i < shares.size(); ++i) {
      rest -= getsShare[i] ? 0 : least[i];
      restShares += getsShare[i] ? shares[i] : 0;
    }
    for (std::size_t i = 0; i < shares.size(); ++i) {
      if (getsShare[i]) {
        const int share = static_cast<int>(rest * shares[i] / restShares);
        getsShare[i] = share >= least[i];
        settled = settled && getsShare[i];
        widths[i] = std::max(share, least[i]);
      }
    }
  }
  return widths;
}

}  // namespace

std::vector<int> ColumnWidths(int width, const std::vector<double>& shares, const std::vector<int>& least,
                              const std::vector<int>& wanted) {
  int spare = width - std::accumulate(least.begin(), least.end(), 0);
  std::vector<int> needed = least;
  const std::vector<int> widths = Shared(width, shares, least);
  bool isMore = false;
  for (std::size_t i = 0; i < shares.size(); ++i) {
    if (wanted[i] > widths[i]) {
      const int more = std::clamp(wanted[i] - least[i], 0, std::max(spare, 0));
      needed[i] += more;
      spare -= more;
      isMore = true;
    }
  }
  return isMore ? Shared(width, shares, needed) : widths;
}
