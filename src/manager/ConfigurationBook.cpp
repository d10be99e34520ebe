#include "manager/ConfigurationBook.h"

#include <string>
#include <string_view>
#include <utility>

#include "manager/Commands.h"
#include "platform/log/Log.h"

namespace vespscope::manager {
namespace {

std::string_view textOf(const Bytes& bytes) { return {reinterpret_cast<const char*>(bytes.data()), bytes.size()}; }

}  // namespace

ConfigurationBook::ConfigurationBook(std::optional<ConfigurationStore> store, std::function<void()> answersWait) {
  if (!store) return;
  load(*store);
  keeper_ = std::make_unique<ConfigurationKeeper>(
      [store = *store](std::int64_t application, const std::optional<Bytes>& toml) {
        return toml ? store.save(application, *toml) : store.remove(application);
      },
      std::move(answersWait));
}

void ConfigurationBook::load(const ConfigurationStore& store) {
  const ConfigurationStore::Kept kept = store.load(limit);
  for (const std::string& problem : kept.problems) problems_.write(problem);
  for (const auto& [application, bytes] : kept.configurations) {
    const Result<Configuration> configuration = Configuration::parse(textOf(bytes));
    if (configuration) {
      active_[application] = std::make_shared<const Configuration>(*configuration);
      continue;
    }
    const Result<std::string> aside = store.setAside(application);
    problems_.write("the configuration kept for application " + std::to_string(application) + " is not used: " +
                    configuration.reason() + " (" + (aside ? "it is now " + *aside : aside.reason()) + ")");
  }
}

void ConfigurationBook::add(std::int64_t application, const Bytes& toml,
                            const std::function<void(const Active&)>& activated, const Answer& answer) {
  const Result<Configuration> configuration = Configuration::parse(textOf(toml));
  if (!configuration) return answer(replyOf(CommandStatus::badConfiguration, configuration.reason()));
  if (active_.size() >= limit && !active_.contains(application)) {
    return answer(replyOf(CommandStatus::tooManyApplications, std::to_string(limit)));
  }
  const Active active = std::make_shared<const Configuration>(*configuration);
  active_[application] = active;
  activated(active);
  keep(application, toml, answer);
}

void ConfigurationBook::clear(std::int64_t application, const Answer& answer) {
  active_.erase(application);
  keep(application, std::nullopt, answer);
}

ConfigurationBook::Active ConfigurationBook::find(std::int64_t application) const {
  const auto found = active_.find(application);
  return found == active_.end() ? nullptr : found->second;
}

void ConfigurationBook::keep(std::int64_t application, std::optional<Bytes> toml, const Answer& answer) {
  if (!keeper_) return answer(replyOf(CommandStatus::ok));
  const char* what = toml ? "the configuration is active, but could not be saved: "
                          : "the configuration is cleared, but could not be deleted: ";
  keeper_->keep(application, std::move(toml), [this, what, answer](const std::optional<std::string>& problem) {
    bus::Reply reply = replyOf(CommandStatus::ok);
    reply.values.set(rhox::kKeyKept, ipc::Object(!problem));
    if (problem) {
      reply.message = what + *problem;
      problems_.write(*problem);
    }
    answer(reply);
  });
}

void ConfigurationBook::sendAnswers() {
  if (keeper_) keeper_->callDone();
}

}  // namespace vespscope::manager
