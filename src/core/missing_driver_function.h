#ifndef OVO_CORE_MISSING_DRIVER_FUNCTION_H
#define OVO_CORE_MISSING_DRIVER_FUNCTION_H

namespace ovo {

// MissingDriverFunction<P>::Call does nothing and returns 0, with the exact type P of the
// slot it fills, so that calling it through the slot is well defined. It stands in for
// vendor functions that no lookup finds and fills every slot of NoContextHooks.
template <typename Pointer>
struct MissingDriverFunction;

template <typename Result, typename... Parameters>
struct MissingDriverFunction<Result (*)(Parameters...)> {
    static Result Call(Parameters...) { return Result(); }
};

}  // namespace ovo

#endif
