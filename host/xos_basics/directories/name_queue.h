/// \file
/// Names that wait their turn, in one block of memory.

#ifndef HOST_XOS_BASICS_DIRECTORIES_NAME_QUEUE_H
#define HOST_XOS_BASICS_DIRECTORIES_NAME_QUEUE_H

#include <cstddef>
#include <cstring>
#include <string>

namespace host {

class NameQueue {
public:
    void add(char const* name) { text_.append(name, std::strlen(name) + 1); }
    bool empty() const { return next_ == text_.size(); }
    char const* first() const { return text_.data() + next_; }
    void dropFirst() { next_ += std::strlen(first()) + 1; }

private:
    std::string text_;
    std::size_t next_ = 0;
};

} // namespace host

#endif
