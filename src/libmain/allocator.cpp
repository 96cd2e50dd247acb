// Routes the plug-in's own allocations to mimalloc. The linker map keeps these symbols
// local, so the host process and the other libraries keep their allocator.
#include <mimalloc.h>

#include <cstddef>
#include <new>

extern "C" {
void* malloc(size_t size) {
    return mi_malloc(size);
}
void* calloc(size_t count, size_t size) {
    return mi_calloc(count, size);
}
void* realloc(void* p, size_t size) {
    return mi_realloc(p, size);
}
void free(void* p) {
    mi_free(p);
}
}

void* operator new(size_t size) {
    return mi_new(size);
}
void* operator new[](size_t size) {
    return mi_new(size);
}
void* operator new(size_t size, const std::nothrow_t&) noexcept {
    return mi_new_nothrow(size);
}
void* operator new[](size_t size, const std::nothrow_t&) noexcept {
    return mi_new_nothrow(size);
}
void* operator new(size_t size, std::align_val_t align) {
    return mi_new_aligned(size, static_cast<size_t>(align));
}
void* operator new[](size_t size, std::align_val_t align) {
    return mi_new_aligned(size, static_cast<size_t>(align));
}
void* operator new(size_t size, std::align_val_t align, const std::nothrow_t&) noexcept {
    return mi_new_aligned_nothrow(size, static_cast<size_t>(align));
}
void* operator new[](size_t size, std::align_val_t align, const std::nothrow_t&) noexcept {
    return mi_new_aligned_nothrow(size, static_cast<size_t>(align));
}

void operator delete(void* p) noexcept {
    mi_free(p);
}
void operator delete[](void* p) noexcept {
    mi_free(p);
}
void operator delete(void* p, size_t size) noexcept {
    mi_free_size(p, size);
}
void operator delete[](void* p, size_t size) noexcept {
    mi_free_size(p, size);
}
void operator delete(void* p, const std::nothrow_t&) noexcept {
    mi_free(p);
}
void operator delete[](void* p, const std::nothrow_t&) noexcept {
    mi_free(p);
}
void operator delete(void* p, std::align_val_t align) noexcept {
    mi_free_aligned(p, static_cast<size_t>(align));
}
void operator delete[](void* p, std::align_val_t align) noexcept {
    mi_free_aligned(p, static_cast<size_t>(align));
}
void operator delete(void* p, size_t size, std::align_val_t align) noexcept {
    mi_free_size_aligned(p, size, static_cast<size_t>(align));
}
void operator delete[](void* p, size_t size, std::align_val_t align) noexcept {
    mi_free_size_aligned(p, size, static_cast<size_t>(align));
}
void operator delete(void* p, std::align_val_t align, const std::nothrow_t&) noexcept {
    mi_free_aligned(p, static_cast<size_t>(align));
}
void operator delete[](void* p, std::align_val_t align, const std::nothrow_t&) noexcept {
    mi_free_aligned(p, static_cast<size_t>(align));
}
