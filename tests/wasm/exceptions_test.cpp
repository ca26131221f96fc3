#include <cstdio>
#include <new>
#include <stdexcept>
#include <string>
#include <vector>

// Exceptions as bindings/js/module/exceptions.cpp has them, in a program of WebAssembly. Prints the
// lines of what is not as it should be.

namespace {

int faults = 0;

void expect(bool isSo, int line) {
    if (isSo) return;
    std::printf("line %d: not so\n", line);
    ++faults;
}
#define EXPECT(isSo) expect((isSo), __LINE__)

int alive = 0;

/// Counts objects.
struct Counted {
    Counted() { ++alive; }
    Counted(const Counted&) { ++alive; }
    ~Counted() { --alive; }
};

struct Left {
    int left = 1;
    virtual ~Left() = default;
};
struct Right {
    int right = 2;
    virtual ~Right() = default;
};
struct Both : Left, Right {
    Counted counted;
};
struct Virtual : virtual Both {};
class Hidden : private std::runtime_error {
  public:
    Hidden() : std::runtime_error("hidden") {}
};

/// Which clause takes what is thrown.
template <typename Throw>
std::string takerOf(const Throw& thrower) {
    try {
        thrower();
    } catch (const std::out_of_range&) {
        return "out of range";
    } catch (const std::logic_error& error) {
        return std::string("logic ") + error.what();
    } catch (const std::bad_alloc&) {
        return "memory";
    } catch (const std::exception&) {
        return "exception";
    } catch (int number) {
        return std::to_string(number);
    } catch (const char* text) {
        return text;
    } catch (...) {
        return "anything";
    }
    return "nothing";
}

void byTypes() {
    EXPECT(takerOf([] {}) == "nothing");
    EXPECT(takerOf([] { throw std::out_of_range("x"); }) == "out of range");
    EXPECT(takerOf([] { throw std::invalid_argument("x"); }) == "logic x");
    EXPECT(takerOf([] { throw std::bad_alloc(); }) == "memory");
    EXPECT(takerOf([] { throw std::runtime_error("x"); }) == "exception");
    EXPECT(takerOf([] { throw 7; }) == "7");
    EXPECT(takerOf([] { throw "text"; }) == "text");
    EXPECT(takerOf([] { throw 7L; }) == "anything");
    EXPECT(takerOf([] { throw Hidden(); }) == "anything");
}

void partsOfObjects() {
    const auto rightOf = [](auto thrower) {
        try {
            thrower();
        } catch (const Right& right) {
            return right.right;
        }
        return 0;
    };
    EXPECT(rightOf([] { throw Both(); }) == 2);
    EXPECT(rightOf([] { throw Virtual(); }) == 2);
    static Both both;
    try {
        throw &both;
    } catch (Right* right) {
        EXPECT(right == &both);
    }
    EXPECT(alive == 1);
}

/// Throws the exception in hand once more, from a function beyond.
void throwOnceMore() {
    throw;
}

void onceMore() {
    std::string way;
    try {
        try {
            try {
                throw Both();
            } catch (const Left&) {
                way += 'l';
                throw;
            }
        } catch (const Right&) {
            way += 'r';
            throwOnceMore();
        }
    } catch (const Both&) {
        way += 'b';
    }
    EXPECT(way == "lrb");
    EXPECT(alive == 1);
}

void inHandlers() {
    std::string way;
    try {
        throw std::runtime_error("outer");
    } catch (const std::exception& outer) {
        try {
            throw std::logic_error("inner");
        } catch (const std::exception& inner) {
            way = std::string(outer.what()) + inner.what();
        }
        way += outer.what();
    }
    EXPECT(way == "outerinnerouter");
    try {
        try {
            throw Both();
        } catch (const Left&) {
            throw std::runtime_error("another");
        }
    } catch (const std::runtime_error& error) {
        EXPECT(std::string(error.what()) == "another");
    }
    EXPECT(alive == 1);
}

/// Cleans up while it throws from the depth.
void deep(int depth) {
    const Counted counted;
    if (depth == 0) throw std::runtime_error("deep");
    deep(depth - 1);
}

/// A destructor that throws and catches within, while another exception is under way.
struct Quarrelsome {
    std::string& way;
    ~Quarrelsome() {
        try {
            throw 1;
        } catch (int) {
            way += 'i';
        }
    }
};

void whileUnwinding() {
    EXPECT(takerOf([] { deep(20); }) == "exception");
    EXPECT(alive == 1);
    std::string way;
    try {
        const Quarrelsome quarrelsome{way};
        throw std::logic_error("l");
    } catch (const std::logic_error& error) {
        way += error.what();
    }
    EXPECT(way == "il");
}

/// What the standard library throws from its headers, and where memory runs out.
void fromTheLibrary() {
    EXPECT(takerOf([] { std::vector<int>().at(0); }) == "out of range");
    EXPECT(takerOf([] { std::vector<char>().reserve(size_t{3} << 30); }) != "nothing");
    std::vector<void*> blocks;
    EXPECT(takerOf([&] {
               for (;;)
                   blocks.push_back(::operator new (size_t{1} << 24));
           }) == "memory");
    for (void* const block : blocks)
        ::operator delete(block);
}

void manyTimes() {
    for (int i = 0; i < 100000; ++i)
        EXPECT(takerOf([] { throw std::out_of_range("again"); }) == "out of range");
}

}  // namespace

int main() {
    byTypes();
    partsOfObjects();
    onceMore();
    inHandlers();
    whileUnwinding();
    fromTheLibrary();
    manyTimes();
    return faults == 0 ? 0 : 1;
}
