-- commonTerms_chs: Simplified Chinese texts of the keys in structured error
-- descriptions. Exactly the keys of commonTerms_eng, in its sections and
-- order; a key this table lacked would read English. Texts are UTF-8 and use
-- only characters of code page 936.
--
-- Sections:
--   1. Usage types: the key shown before ": " and the value
--   2. DriverSetup and session-information messages (elaborations)
--   3. Other elaboration texts (the key is the English text)
--   4. Debug item keys

local entries = {
  -- 1. Usage types -------------------------------------------------------------
  kUsageTypeAffectedAttribute = "受影响的属性",
  kUsageTypeAttributeId = "属性",
  kUsageTypeAttributeIdentifier = "属性标识符",
  kUsageTypeConflictingAttr = "冲突的属性",
  kUsageTypeConflictingProperty = "冲突的特性",
  kUsageTypeDevice = "设备",
  kUsageTypeFilePath = "文件路径",
  kUsageTypeInvalidIdentifier = "无效的标识符",
  kUsageTypeParameterName = "参数名称",
  kUsageTypeRequestedDeviceName = "请求的设备名称",
  kUsageTypeRequestedValue = "请求的值",
  kUsageTypeUnspecifiedProperty = "未指定的特性",
  kSidlUsageTypeErrno = "系统调用返回的 errno 值",

  -- 2. DriverSetup and session-information messages ---------------------------
  kSidlSetupContainsEqual = "DriverSetup 字符串不能包含“=”。",
  kSidlSetupNotParsed = "无法解析 DriverSetup 字符串。有关字符串格式，请参阅文档。",
  kSidlInvalidTag = "DriverSetup 标记无效。",
  kSidlRepeatedTag = "DriverSetup 标记重复。",
  kSidlNotInteger = "DriverSetup 值不是整数。",
  kSidlNotBoolean = "DriverSetup 值不是布尔值。请使用 0 或 1。",
  kSidlNoTag = "未指定 DriverSetup 标记。请检查 DriverSetup 字符串。",
  kSidlNoValue = "DriverSetup 中有一个条目没有值。",
  kSidlInvalidLanguage = "DriverSetup 中指定的语言无效。",
  kSidlInvalidResourceName = "资源名称无效。",
  kSidlRepeatedResourceName = "DriverSetup 字符串包含重复的资源名称。在 DriverSetup 中每个资源名称" ..
    "只能列出一次。",
  kSidlNoResourceName = "选项字符串中的 DriverSetup 标记缺少 ResourceName 字段。有关可接受的字符串" ..
    "格式，请参阅选项字符串的文档。",
  kSidlInvalidFileHandle = "文件句柄无效。",
  kSidlInitialization = "无法初始化会话信息。",
  kSidlMaxNumSessionsExceeded = "已超过最大会话数。",
  kSidlSharedMemMutex = "无法获取共享会话信息的锁。",

  -- 3. Other elaboration texts --------------------------------------------------
  ["Oversized session information table data section"] = "会话信息表的数据段过大",
  ["You must set the CloseFunctionPtr prior to calling any functions."] =
    "调用任何函数之前，必须先设置 CloseFunctionPtr。",
  ["Windows generated an error"] = "操作系统报告了错误",
  ["Windows Error Code:"] = "系统错误代码",
  ["Windows Error Message:"] = "系统错误消息",

  -- 4. Debug item keys ----------------------------------------------------------
  Component = "组件",
  File = "文件",
  Line = "行",
  ["Internal Error"] = "内部错误",
  -- The parts of a description the translator did not use, shown as JSON;
  -- the key is a name and stays the same in every language.
  rest_of_input_json = "rest_of_input_json",
}

return require("cvmxl_utilities").stringTable(entries)
