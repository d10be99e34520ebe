// One elementary file of the SIM card (3GPP TS 31.102).
//
// Written by messagegen from schema/mobility.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <memory>
#include <string_view>
#include <tuple>
#include <utility>

#include "messages/Message.h"

namespace vespscope {

class ElementaryFile final : public Message<ElementaryFile> {
 public:
  static constexpr std::string_view className = "ElementaryFile";

  [[nodiscard]] std::uint32_t efId() const noexcept { return _efId; }
  void setEfId(std::uint32_t efId) noexcept {
    _efId = efId;
    _has.set(0);
  }
  void setHasEfId(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasEfId() const noexcept { return _has.test(0); }

  // Null when absent.
  [[nodiscard]] const Bytes* content() const noexcept { return _content.get(); }
  void setContent(Bytes content) { _content = std::make_shared<const Bytes>(std::move(content)); }
  void clearContent() noexcept { _content = nullptr; }
  [[nodiscard]] bool hasContent() const noexcept { return _content != nullptr; }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint32>(1, "ef_id", &Self::_efId, 0),
        contentField(2, "content", &Self::_content));
  }

 private:
  friend class Message<ElementaryFile>;

  std::shared_ptr<const Bytes> _content;
  std::uint32_t _efId = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<ElementaryFile>;

}  // namespace vespscope
