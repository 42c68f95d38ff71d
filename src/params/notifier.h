#pragma once

namespace plugcore {

// The changing side of a notification (a parameter).
class NotifierInterface {
 public:
  virtual ~NotifierInterface() = default;
};

// The side that is told after a parameter changed (engine, band, feedback line).
class NotifiedInterface {
 public:
  virtual ~NotifiedInterface() = default;
  virtual void notify(NotifierInterface* notifier) = 0;
};

}  // namespace plugcore
