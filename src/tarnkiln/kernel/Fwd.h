/// \file
/// Forward declarations of the kernel's classes.
#pragma once

namespace tarn::kiln {
class AbstractTransactionImpl;
class ChangeRecords;
class ChangesHolder;
class ConstellationListener;
class ElementHandle;
class ElementId;
class ElementImpl;
class ExtensionListener;
class Feature;
class Listener;
class ListenerHolderBase;
class Model;
class ModelConstellation;
class ModelElement;
class ModelId;
class ProxyId;
class ReflectiveDataType;
class ReportData;
class Transaction;
class Value;
class ValueMeta;
enum class ValueFlags : unsigned int;

namespace internal {
class NestedTransaction;
class TransactionGroup;
class TransactionImpl;
}  // namespace internal
}  // namespace tarn::kiln
