#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <exception>
#include <new>
#include <typeinfo>

// What C++ asks of its library to throw and to catch, after "C++ ABI for Itanium: Exception Handling".
// The packaged library of C++ for WebAssembly has none of it, and ends the program where memory runs
// out; the modules are to tell their caller instead.
//
// WebAssembly unwinds by itself: it hands every catching place of a function what was thrown, and the
// place asks the personality which of its clauses, if any, is for it. There is one thread.

namespace __cxxabiv1 {

/// The part of the packaged library's type_info that tells whether a clause is for an exception; its
/// functions stand in the order of their slots.
class __shim_type_info : public std::type_info {
  public:
    ~__shim_type_info() override;
    virtual void noop1() const;
    virtual void noop2() const;
    /// `object` is moved to what the clause gets.
    virtual bool can_catch(const __shim_type_info* thrown, void*& object) const = 0;
};

}  // namespace __cxxabiv1

namespace {

using TypeInfo = __cxxabiv1::__shim_type_info;

/// Destructors return the object on WebAssembly.
using Destructor = void* (*)(void*);

/// What stands before an object that is thrown.
struct alignas(std::max_align_t) Exception {
    const TypeInfo* type;
    Destructor destructor;
    void* caught;     ///< the object, or the part of it that the last clause asked for
    Exception* next;  ///< the one that was caught before and is not done with
    int handlers;     ///< how many have it in hand; below 0 when it is thrown once more

    void* object() { return this + 1; }
};

Exception* caughtLast = nullptr;

/// For what is thrown when memory has run out.
struct SetAside {
    static constexpr std::size_t kBytes = 128;
    alignas(std::max_align_t) unsigned char place[kBytes];
    bool isTaken;
};
SetAside setAside[4];

void* placeSetAside(std::size_t bytes) {
    for (SetAside& each : setAside) {
        if (each.isTaken || bytes > SetAside::kBytes) continue;
        each.isTaken = true;
        return each.place;
    }
    std::abort();
}

void giveBack(Exception* exception) {
    for (SetAside& each : setAside) {
        if (reinterpret_cast<unsigned char*>(exception) != each.place) continue;
        each.isTaken = false;
        return;
    }
    std::free(exception);
}

Exception* before(void* object) {
    return static_cast<Exception*>(object) - 1;
}

[[noreturn]] void unwind(Exception* exception) {
    constexpr int kTagOfCxx = 0;
    __builtin_wasm_throw(kTagOfCxx, exception);
}

/// Reads the numbers of a table of clauses: seven bits in a byte, the lowest first.
class TableReader {
  public:
    explicit TableReader(const uint8_t* at) : mAt(at) {}

    const uint8_t* at() const { return mAt; }
    uint8_t byte() { return *mAt++; }

    uint32_t number() {
        uint32_t bits = 0;
        unsigned int shift = 0;
        do {
            bits |= (*mAt & 0x7FU) << shift;
            shift += 7;
        } while ((*mAt++ & 0x80U) != 0);
        mBits = shift;
        return bits;
    }
    int32_t signedNumber() {
        uint32_t bits = number();
        const bool isNegative = mBits < 32 && (bits >> (mBits - 1) & 1U) != 0;
        if (isNegative) bits |= ~uint32_t{0} << mBits;
        return static_cast<int32_t>(bits);
    }

  private:
    const uint8_t* mAt;
    unsigned int mBits = 0;
};

/// The clauses of one function (the ABI's language-specific data area).
struct Clauses {
    const TypeInfo* const* types;  ///< behind the last: a filter of 1 means the one before
    const uint8_t* places;
    const uint8_t* actions;

    explicit Clauses(const uint8_t* table) : types(nullptr) {
        constexpr uint8_t kOmitted = 0xFF;
        TableReader reader(table);
        if (reader.byte() != kOmitted) reader.number();  // where places are counted from: not used here
        if (reader.byte() != kOmitted) {
            const uint32_t offset = reader.number();
            types = reinterpret_cast<const TypeInfo* const*>(reader.at() + offset);
        }
        reader.byte();  // how places are written: as numbers
        const uint32_t size = reader.number();
        places = reader.at();
        actions = places + size;
    }

    /// Where the clauses of a catching place begin; null for one that only cleans up.
    const uint8_t* firstAction(uint32_t place) const {
        TableReader reader(places);
        for (uint32_t i = 0; i < place; ++i) {
            reader.number();
            reader.number();
        }
        reader.number();
        const uint32_t action = reader.number();
        return action == 0 ? nullptr : actions + action - 1;
    }
};

bool isFor(const TypeInfo* type, Exception& exception) {
    void* object = exception.object();
    const bool takes = type == nullptr || type->can_catch(exception.type, object);
    if (takes) exception.caught = object;
    return takes;
}

/// The number of the clause that is for the exception, 0 for none.
uint32_t clauseFor(Exception& exception, const uint8_t* table, uint32_t place) {
    const Clauses clauses(table);
    const uint8_t* action = clauses.firstAction(place);
    while (action != nullptr) {
        TableReader reader(action);
        const int32_t filter = reader.signedNumber();
        if (filter > 0 && isFor(clauses.types[-filter], exception)) return static_cast<uint32_t>(filter);
        const uint8_t* const link = reader.at();
        const int32_t offset = reader.signedNumber();
        action = offset == 0 ? nullptr : link + offset;
    }
    return 0;
}

void* allocatedOrNull(std::size_t bytes) {
    return std::malloc(bytes == 0 ? 1 : bytes);
}

void* allocated(std::size_t bytes) {
    void* const block = allocatedOrNull(bytes);
    if (block == nullptr) throw std::bad_alloc();
    return block;
}

}  // namespace

extern "C" {

/// By which a catching place tells where it is, and is told its clause.
struct {
    uint32_t place;
    const uint8_t* table;
    uint32_t clause;
} thread_local __wasm_lpad_context;

int _Unwind_CallPersonality(void* exception) {
    __wasm_lpad_context.clause = clauseFor(*static_cast<Exception*>(exception),
                                           __wasm_lpad_context.table, __wasm_lpad_context.place);
    return 0;
}

void* __cxa_allocate_exception(std::size_t bytes) noexcept {
    const std::size_t size = sizeof(Exception) + bytes;
    void* place = bytes > SIZE_MAX - sizeof(Exception) ? nullptr : std::malloc(size);
    if (place == nullptr) place = placeSetAside(size);
    return static_cast<Exception*>(place)->object();
}

void __cxa_free_exception(void* object) noexcept {
    giveBack(before(object));
}

[[noreturn]] void __cxa_throw(void* object, const TypeInfo* type, Destructor destructor) {
    Exception* const exception = before(object);
    *exception = {type, destructor, object, nullptr, 0};
    unwind(exception);
}

void* __cxa_begin_catch(void* thrown) noexcept {
    auto* const exception = static_cast<Exception*>(thrown);
    exception->handlers = exception->handlers < 0 ? 1 - exception->handlers : exception->handlers + 1;
    if (caughtLast != exception) {
        exception->next = caughtLast;
        caughtLast = exception;
    }
    return exception->caught;
}

void __cxa_end_catch() {
    Exception* const exception = caughtLast;
    const bool isThrownOnceMore = exception->handlers < 0;
    exception->handlers += isThrownOnceMore ? 1 : -1;
    if (exception->handlers != 0) return;
    caughtLast = exception->next;
    if (isThrownOnceMore) return;
    if (exception->destructor != nullptr) exception->destructor(exception->object());
    giveBack(exception);
}

[[noreturn]] void __cxa_rethrow() {
    if (caughtLast == nullptr) std::terminate();
    caughtLast->handlers = -caughtLast->handlers;
    unwind(caughtLast);
}

}  // extern "C"

// In the place of the packaged ones, which end the program.
void* operator new(std::size_t bytes) {
    return allocated(bytes);
}
void* operator new[](std::size_t bytes) {
    return allocated(bytes);
}
void* operator new(std::size_t bytes, const std::nothrow_t& /*tag*/) noexcept {
    return allocatedOrNull(bytes);
}
void* operator new[](std::size_t bytes, const std::nothrow_t& /*tag*/) noexcept {
    return allocatedOrNull(bytes);
}
