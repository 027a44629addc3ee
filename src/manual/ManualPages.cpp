#include "manual/ManualPages.h"

#include <algorithm>

namespace {

constexpr std::string_view Heading = "## ";

std::optional<std::size_t> PlaceOf(const std::vector<ManualPage>& pages, auto&& fits) {
  const auto page = std::find_if(pages.begin(), pages.end(), fits);
  return page == pages.end() ? std::nullopt : std::optional(static_cast<std::size_t>(page - pages.begin()));
}

/// Bytes of letters beyond ASCII count as letters.
bool IsLetterOrDigit(char byte) {
  return (byte >= 'a' && byte <= 'z') || (byte >= '0' && byte <= '9') ||
         static_cast<unsigned char>(byte) >= 0x80;
}

}  // namespace

std::vector<ManualPage> ManualPages(std::string_view markdown) {
  std::vector<ManualPage> pages;
  while (!markdown.empty()) {
    const std::size_t end = std::min(markdown.find('\n'), markdown.size() - 1) + 1;
    const std::string_view line = markdown.substr(0, end);
    if (line.starts_with(Heading)) {
      std::string_view title = line.substr(Heading.size());
      title = title.substr(0, title.find_last_not_of("\r\n") + 1);
      pages.push_back({std::string(title), {}});
    }
    if (!pages.empty()) {
      pages.back().Text += line;
    }
    markdown.remove_prefix(end);
  }
  return pages;
}

const std::vector<WindowPage>& WindowPages() {
  static const std::vector<WindowPage> pages = {
      {"frmRx", "An evening with Tessarine", "使用 Tessarine 的一晚"},
      {"UploadProgress", "The download", "下载"},
      {"PlayerDetails", "Player details", "玩家详情"},
      {"BonusPoints", "Bonus points", "奖励分"},
      {"AdminData", "Administration data", "管理数据"},
      {"MissionResultEntry", "Mission results", "任务结果"},
      {"Scenarios", "Missions", "任务"},
      {"MissionNameEntry", "Missions", "任务"},
      {"Members", "Members", "会员"},
      {"ExportMembers", "Members", "会员"},
      {"ImportMembers", "Members", "会员"},
      {"ButtonSwipe", "The reader of membership buttons", "会员扣读取器"},
      {"GameCharts", "Game charts", "比赛图表"},
      {"PrintOptions", "Score sheets", "成绩单"},
      {"SheetProgressWindow", "Score sheets", "成绩单"},
      {"ExportGames", "Export", "导出"},
      {"ImportGames", "Past games", "历史比赛"},
      {"Settings", "Settings", "设置"},
      {"SoldieringCalc", "Soldiering calculation", "战功计算"},
      {"RemoteManage", "Remote management", "远程管理"},
      {"BoxConfig", "Utility boxes", "功能装置"},
      {"ChargeiButton", "Charging buttons", "信息扣充值"},
      {"FirmwareFlash", "Firmware", "固件"},
      {"frmBootload", "Devices with a PIC24F boot loader", "带 PIC24F 引导程序的设备"},
      {"ISD_rec", "Sound recorder", "声音录制"},
      {"BackupCopies", "Backup copies", "备份副本"},
      {"TakeOver", "Files from an old installation", "旧安装的文件"},
      {"AudienceSettings", "Audience board", "观众大屏"},
      {"GuestNameEntry", "Audience board", "观众大屏"},
      {"About", "If you need help", "需要帮助时"}};
  return pages;
}

std::optional<std::size_t> PageOfWindow(std::string_view window, const std::vector<ManualPage>& pages) {
  const auto known = std::find_if(WindowPages().begin(), WindowPages().end(),
                                  [window](const WindowPage& each) { return each.Window == window; });
  if (known == WindowPages().end()) {
    return std::nullopt;
  }
  return PlaceOf(pages, [&known](const ManualPage& page) {
    return page.Title == known->English || page.Title == known->Chinese;
  });
}

std::string AnchorOf(std::string_view heading) {
  std::string anchor;
  for (char byte : heading) {
    if (byte >= 'A' && byte <= 'Z') {
      byte = static_cast<char>(byte - 'A' + 'a');
    }
    if (byte == ' ' || byte == '-') {
      anchor += '-';
    } else if (IsLetterOrDigit(byte)) {
      anchor += byte;
    }
  }
  return anchor;
}

std::optional<std::size_t> PageOfLink(std::string_view link, const std::vector<ManualPage>& pages) {
  if (!link.starts_with('#')) {
    return std::nullopt;
  }
  link.remove_prefix(1);
  return PlaceOf(pages, [link](const ManualPage& page) { return AnchorOf(page.Title) == link; });
}
