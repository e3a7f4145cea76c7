// ClassFuzz: what the configuration-class fuzz targets share: the input parsed as XML into an
// element tree with the library's logging quiet (read failures are expected and logging them
// only slows), and the properties every class must keep whatever tree it reads. Any mismatch
// aborts, which libFuzzer reports as a crash. Header only; each target is one process.
#pragma once

#include <ace/Log_Msg.h>

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <exception>

#include "Vesk/XmlUtils.h"

namespace ClassFuzz {

// Parses data as XML into tree; false when the reader refused it (cleanly).
inline bool parse(const std::uint8_t* data, std::size_t size, Vesk::Element& tree) {
    static const bool quiet = [] {
        ACE_LOG_MSG->priority_mask(LM_CRITICAL, ACE_Log_Msg::PROCESS);
        return true;
    }();
    (void)quiet;
    try {
        Vesk::XmlUtils::parse(reinterpret_cast<const char*>(data), size, tree);
    } catch (const std::exception&) {
        return false;
    }
    return true;
}

// A copy of object compares equal to it.
template <class T>
void copiesEqual(const T& object) {
    const T copy = object;
    if (!(copy == object)) {
        std::abort();
    }
}

// A read-only object refuses to write (throws).
template <class T>
void refusesWrite(const T& object) {
    try {
        object.writeVesk();
    } catch (const std::exception&) {
        return;
    }
    std::abort();
}

// What T writes after reading tree reads back complete, and equal when T's own read was
// complete (a read cut short leaves derived data unresolved).
template <class T>
void readWriteRead(const Vesk::Element& tree) {
    T first;
    const bool complete = first.readVesk(tree);
    T second;
    if (!second.readVesk(*first.writeVesk()) || (complete && !(first == second))) {
        std::abort();
    }
}

// readWriteRead for each of the classes.
template <class... T>
void readWriteReadAll(const Vesk::Element& tree) {
    (readWriteRead<T>(tree), ...);
}

// T reads tree twice (the second read appends) and copies equal.
template <class T>
void readTwice(const Vesk::Element& tree) {
    T object;
    object.readVesk(tree);
    object.readVesk(tree);
    copiesEqual(object);
}

// A read-only T reads tree twice, copies equal and refuses to write.
template <class T>
void readTwiceRefuseWrite(const Vesk::Element& tree) {
    T object;
    object.readVesk(tree);
    object.readVesk(tree);
    copiesEqual(object);
    refusesWrite(object);
}

// readTwiceRefuseWrite for each of the classes.
template <class... T>
void readTwiceRefuseWriteAll(const Vesk::Element& tree) {
    (readTwiceRefuseWrite<T>(tree), ...);
}

}  // namespace ClassFuzz
