// Screens: the base of every screen, and the table screen with its data-source operations.
#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/application/TableCell.h"

namespace vespscope::application {

struct IndexPath {
  std::size_t section = 0;
  std::size_t row = 0;
  friend bool operator==(const IndexPath&, const IndexPath&) = default;
};

enum class Colour { systemBackground };

// The base of every screen. Objects are shared: the navigation stack and running timers keep them alive.
class ViewController : public std::enable_shared_from_this<ViewController> {
 public:
  virtual ~ViewController() = default;

  // Called once, before the screen is shown for the first time.
  virtual void viewDidLoad() {}
  virtual void didReceiveMemoryWarning() {}

  // Calls `viewDidLoad` unless it has been called.
  void loadViewIfNeeded();

  // The screen's name for the user: the scene's title, else the label of the row that led here.
  [[nodiscard]] const std::string& title() const { return title_; }
  void setTitle(std::string title) { title_ = std::move(title); }

  [[nodiscard]] std::optional<Colour> backgroundColour() const { return backgroundColour_; }
  void setBackgroundColour(Colour colour) { backgroundColour_ = colour; }

 private:
  std::string title_;
  std::optional<Colour> backgroundColour_;
  bool loaded_ = false;
};

// The table of a table screen: makes cells from prototypes and notifies its frontend when to read all data again.
class TableView {
 public:
  void registerPrototype(CellPrototype prototype);
  // Makes a cell without text; an identifier without a prototype is a programming error.
  [[nodiscard]] std::shared_ptr<TableCell> dequeueReusableCell(const std::string& identifier, IndexPath path);

  // Makes the frontend read the table again.
  void reloadData();
  [[nodiscard]] std::uint64_t reloadCount() const { return reloadCount_; }

  // A footer of zero height keeps separator lines from being drawn below the last row.
  void setEmptyFooter() { emptyFooter_ = true; }
  [[nodiscard]] bool hasEmptyFooter() const { return emptyFooter_; }

 private:
  std::map<std::string, CellPrototype> prototypes_;
  std::uint64_t reloadCount_ = 0;
  bool emptyFooter_ = false;
};

struct Segue {
  std::shared_ptr<ViewController> source;
  std::shared_ptr<ViewController> destination;
};

// The object that started a segue; only cells do.
struct SegueSender {
  std::shared_ptr<TableCell> cell;  // null when the sender is not a cell
};

inline constexpr double automaticDimension = -1.0;  // a row sizes itself to its text

class TableViewController : public ViewController {
 public:
  [[nodiscard]] virtual std::size_t numberOfSections() { return 1; }
  [[nodiscard]] virtual std::size_t numberOfRows(std::size_t section) = 0;
  [[nodiscard]] virtual std::shared_ptr<TableCell> cellForRow(IndexPath path) = 0;
  [[nodiscard]] virtual std::optional<std::string> titleForHeader(std::size_t /*section*/) { return std::nullopt; }
  [[nodiscard]] virtual double heightForRow(IndexPath /*path*/) { return automaticDimension; }
  [[nodiscard]] virtual double estimatedHeightForRow(IndexPath /*path*/) { return automaticDimension; }
  virtual void prepareForSegue(const Segue& /*segue*/, const SegueSender& /*sender*/) {}

  [[nodiscard]] TableView& tableView() { return tableView_; }
  [[nodiscard]] const TableView& tableView() const { return tableView_; }

 private:
  TableView tableView_;
};

}  // namespace vespscope::application
