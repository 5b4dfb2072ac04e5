#pragma once

namespace velkui::ui {

// The base of every message a control sends: the node the message is about.
// Messages are built on the stack for one notification; listeners must not
// keep the pointer.
template <typename Node>
class MessageT {
 public:
  explicit MessageT(Node* subject = nullptr) : subject_(subject) {}
  MessageT(const MessageT&) = default;
  MessageT& operator=(const MessageT&) = default;
  virtual ~MessageT() = default;

  Node* GetSubject() const { return subject_; }
  void SetSubject(Node* subject) { subject_ = subject; }

 private:
  Node* subject_;
};

}  // namespace velkui::ui
