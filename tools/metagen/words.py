"""Names that a description can't give because they mean something in C++."""

RESERVED = frozenset("""
    alignas alignof and and_eq asm auto bitand bitor bool break case catch char char8_t char16_t
    char32_t class compl concept const consteval constexpr constinit const_cast continue co_await
    co_return co_yield decltype default delete do double dynamic_cast else enum explicit export
    extern false float for friend goto if inline int long mutable namespace new noexcept not not_eq
    nullptr operator or or_eq private protected public register reinterpret_cast requires return
    short signed sizeof static static_assert static_cast struct switch template this thread_local
    throw true try typedef typeid typename union unsigned using virtual void volatile wchar_t while
    xor xor_eq final override import module
""".split())

# What generated code means by these names in the namespace of a client.
LIBRARY = frozenset("""
    AbstractOwnedCollection ElementMap ElementMultimap ElementSequence Feature Model ModelElement
    PrimitiveSequence PrimitiveSet ProxyId ReferenceCollection Slot Transaction UUID
    UnorderedElementSet Value internal meta query reportException string support ustring boost std
    tarn tarnkiln Impl Builder BuilderBase BuilderImpl Constrainables Storage
""".split())

# Functions and constants of every element that a member of such a name would hide.
MEMBERS = frozenset("""
    aboutToDestroy announceContainerChange basicContainer basicDisassociateAll basicGetReference
    basicSetContainer checkCircularContainment checkCompatibleModel collectionInvalidated container
    containerFeature containerImpl containerProperty containmentFeature containmentFeatureImpl
    convertReferencesToProxies convertToProxy convertToProxySlot copyStateFromStorage copyValue
    createChanges createStorage destroy destroyRecursively didCreate disassociateIncoming doDestroy
    getContainment getMetaClass getModel getModelImpl getPersistentProxyId getPropertyByIndex
    getPropertyValue getProxyId getProxyIdImpl getRefCount getUuid getValidity hasPropertyValue
    identifier invalidate inverseAdd inverseAddSlot inverseContainsProxyTo
    inverseContainsProxyToSlot inverseRemove inverseRemoveSlot invoke isLive isProxy isTopLevel
    makeUncontained notifyCreated notifyDestroying notifyModifying pinContainer recordOldContainer
    removeRef self setInvalidateCallback setPropertyValue storeLink unpinContainer visitReferences
    IN_MEMORY_ONLY NO_INDEX NO_PROXY_RESOLVE PRIVILEGED_ACCESS PUBLIC_ACCESS SLOTS
""".split())

# Types of search instances, whose members are named like properties.
SEARCH_INSTANCES = frozenset("Constrainables Handle".split())
