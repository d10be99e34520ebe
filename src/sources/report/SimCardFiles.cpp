#include "sources/report/SimCardFiles.h"

#include <memory>
#include <utility>

#include "messages/mobility/ElementaryFile.h"

namespace vespscope::sources {

KCellularSimCardFiles simCardFilesMessage(const std::vector<CardFile>& files) {
  KCellularSimCardFiles message;
  for (const CardFile& each : files) {
    auto file = std::make_shared<ElementaryFile>();
    file->setEfId(each.id);
    file->setContent(each.content);
    message.addEfList(std::move(file));
  }
  return message;
}

}  // namespace vespscope::sources
