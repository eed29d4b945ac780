-- errors_chs: Simplified Chinese static descriptions of status codes.
--
-- Exactly the keys of errors_eng, in its sections and order, so the two can
-- be compared line by line. Texts are UTF-8 and use only characters of code
-- page 936, to which the translator converts them on request.
--
-- Terms used throughout: session 会话, attribute 属性, channel 通道,
-- acquisition 采集, record 记录, trigger 触发, driver 驱动程序, server
-- 服务器, time-out 超时, instrument 仪器, device 设备, resource 资源, option
-- string 选项字符串, sample 采样点.
--
-- Sections, in order:
--   1. IVI engine status codes that this system raises
--   2. Remoting layer: sessions, reservation and privileges
--   3. Remoting layer: transport and protocol
--   4. Infrastructure codes (mapped into 0xBFFA9400 to 0xBFFA9500)
--   5. Host-environment and system codes
--   6. The stand-in IVI engine's own codes
--   7. The simulated digitizer driver's own codes

local entries = {
  -- 1. IVI engine status codes that this system raises ----------------------
  [0xBFFA0000] = "发生不可恢复的故障。无法加载 IVI 引擎库，或其发生了驱动程序无法" ..
    "恢复的故障。",
  [0xBFFA0009] = "IVI 引擎库或驱动程序库中缺少此操作所需的函数。",
  [0xBFFA000F] = "参数无效。函数的某个参数值不被允许，例如缓冲区大小为负数或未提供" ..
    "输出指针。",
  [0xBFFA0010] = "值无效。参数或属性的值超出范围，例如所请求的采样点数或波形点数，" ..
    "或记录长度超过所请求的采样点数。",
  [0xBFFA0013] = "不支持该值。此操作无法处理所请求的数据类型或大小。",
  [0xBFFA004A] = "选项字符串包含未知的选项名称，或该选项无法更改。请检查" ..
    "选项字符串及其 DriverSetup 条目的语法。",
  [0xBFFA004C] = "选项字符串或其 DriverSetup 条目包含无效值。",
  [0xBFFA0056] = "系统内存不足，或无法创建共享资源。",
  [0xBFFA0058] = "必需的指针参数为 NULL。",
  [0xBFFA0060] = "系统配置中不存在该资源名称或逻辑名称。",

  -- 2. Remoting layer: sessions, reservation and privileges -----------------
  [0xBFFA1190] = "会话句柄无效。该会话从未打开，或已关闭。",
  [0xBFFA402B] = "波形请求返回多条记录，但此调用不允许返回多条" ..
    "记录。",
  [0xBFFA402E] = "该资源已被其他进程预留，或会话不具备此操作所需的" ..
    "权限。",
  [0xBFFA40BA] = "在拥有该仪器的进程中，获取、读取或查询操作失败。",
  [0xBFFA8BF0] = "各设备的调试会话设置不一致。一起使用的所有设备必须" ..
    "具有相同的调试会话设置。",
  [0xBFFA8CF0] = "选项字符串的 DriverSetup 条目未正确指定其资源。",
  [0xBFFA9175] = "资源名称不明确：有多个设备与之匹配。",
  [0xBFFA9178] = "该资源的服务器已存在，且属于另一个驱动程序会话。",
  [0xBFFA9181] = "会话权限不足，无法执行此操作。该仪器由另一个会话" ..
    "控制。",
  [0xBFFA9182] = "在拥有该仪器的进程中，操作失败。",

  -- 3. Remoting layer: transport and protocol --------------------------------
  [0xBFFA914E] = "远程调用失败：服务器返回了应用程序错误，例如缺少结果或" ..
    "应答顺序错误。",
  [0xBFFA914F] = "远程调用失败：无法对消息进行编码或解码。",
  [0xBFFA9150] = "远程调用失败：消息包含无效数据。",
  [0xBFFA9151] = "远程调用失败：消息包含负数大小。",
  [0xBFFA9152] = "远程调用失败：消息超出大小限制。",
  [0xBFFA9153] = "远程调用失败：不支持该消息的协议版本。",
  [0xBFFA9154] = "远程调用失败：消息使用了尚未实现的协议功能。",
  [0xBFFA9155] = "远程调用失败：与服务器的连接报告了错误。",
  [0xBFFA9156] = "无法打开与服务器的连接。请确认拥有该仪器的进程正在" ..
    "运行。",
  [0xBFFA9157] = "与服务器的连接超时。",
  [0xBFFA9158] = "与服务器的连接意外关闭。",
  [0xBFFA9159] = "与服务器的连接中断。",
  [0xBFFA915A] = "使用与服务器的连接时传入了无效参数。",
  [0xBFFA915B] = "从服务器接收的数据已损坏。",
  [0xBFFA915C] = "由于内部错误，与服务器的连接失败。",

  -- 4. Infrastructure codes (original values; reported as 0xBFFA9400 + n) ----
  [-52000] = "内存不足，无法完成该操作。",
  [-52003] = "发生内部错误。",
  [-52005] = "向内部函数传递了无效的句柄或参数。",
  [-52006] = "文件句柄无效，或无法打开文件。",
  [-52008] = "系统调用失败。",
  [-52027] = "无法在字符编码之间转换文本。",
  [-52029] = "不支持该错误描述的格式。",

  -- 5. Host-environment and system codes -------------------------------------
  [0xBFFF0000] = "发生意外的系统错误。",
  [0xBFFF0011] = "未找到该设备，或该设备不受此驱动程序支持。",
  [0xBFFF003C] = "内存不足，无法调整数组大小。",
  [0xBFFF0078] = "无法调整数组大小：主机环境的内存管理器拒绝了" ..
    "该请求。",

  -- 6. The stand-in IVI engine's own codes -------------------------------------
  -- Codes the engine shares with section 1 (0xBFFA0000, 0xBFFA0009, 0xBFFA000F,
  -- 0xBFFA0010, 0xBFFA0013, 0xBFFA004A, 0xBFFA004C, 0xBFFA0058) and section 2
  -- (0xBFFA1190) keep their text there. The engine defines no warnings.
  [0xBFFA0002] = "无法打开文件，可能是文件不存在，或此进程无权" ..
    "读取该文件。",
  [0xBFFA0003] = "读取文件时出错。",
  [0xBFFA000C] = "IVI 引擎会话无法识别该属性 ID。",
  [0xBFFA000D] = "该属性为只读属性，无法设置。",
  [0xBFFA000E] = "该属性为只写属性，无法读取。",
  [0xBFFA0011] = "IVI 引擎不支持该函数。",
  [0xBFFA0012] = "此会话不支持该属性。",
  [0xBFFA0014] = "该类型不是有效的属性类型。",
  [0xBFFA0015] = "属性与读写该属性的函数的数据类型不一致。",
  [0xBFFA0017] = "该项已存在，例如重复添加了某个属性或通道名称。",
  [0xBFFA0018] = "逻辑名称配置文件包含无效的行。",
  [0xBFFA001B] = "该属性没有范围表。",
  [0xBFFA001C] = "范围表无效。",
  [0xBFFA001F] = "该会话没有通道表。",
  [0xBFFA0020] = "会话无法识别该通道名称或重复功能名称。",
  [0xBFFA0021] = "无法分配系统资源。",
  [0xBFFA0030] = "调用线程未持有该会话的锁。",
  [0xBFFA0031] = "该属性需要通道名称或重复功能名称。",
  [0xBFFA0032] = "该属性不接受通道名称或重复功能名称。",
  -- Parameter position errors: parameter 1 to 8 of the function has an invalid value.
  [0xBFFC0001] = "函数的参数 1 的值无效。",
  [0xBFFC0002] = "函数的参数 2 的值无效。",
  [0xBFFC0003] = "函数的参数 3 的值无效。",
  [0xBFFC0004] = "函数的参数 4 的值无效。",
  [0xBFFC0005] = "函数的参数 5 的值无效。",
  [0xBFFC0006] = "函数的参数 6 的值无效。",
  [0xBFFC0007] = "函数的参数 7 的值无效。",
  [0xBFFC0008] = "函数的参数 8 的值无效。",

  -- 7. The simulated digitizer driver's own codes ------------------------------
  -- Errors 0xBFFA5000 to 0xBFFA5014, then warnings from 0x3FFA5000.
  [0xBFFA5000] = "该会话句柄未指向数字化仪驱动程序的已打开会话。",
  [0xBFFA5001] = "该通道名称或通道列表对此仪器无效。",
  [0xBFFA5002] = "该属性 ID 不是数字化仪驱动程序的属性，或此仪器不" ..
    "支持该属性。",
  [0xBFFA5003] = "属性的数据类型与读写该属性的函数的数据类型不同。",
  [0xBFFA5004] = "值超出仪器允许的范围。",
  [0xBFFA5005] = "必需的指针参数为空指针。",
  [0xBFFA5006] = "缓冲区太小，无法容纳数据。",
  [0xBFFA5007] = "采集未在超时时间内完成，或在获取操作等待采集期间" ..
    "采集无法完成。",
  [0xBFFA5008] = "尚未启动或完成任何采集，因此没有可返回的数据。",
  [0xBFFA5009] = "该属性为只读属性，无法写入；或为只写属性，无法" ..
    "读取。",
  [0xBFFA500A] = "已保存的属性配置已损坏、不完整，或为其他型号创建。",
  [0xBFFA500B] = "无法打开、读取或写入该文件。",
  [0xBFFA500C] = "寄存器偏移量或大小无效，或该寄存器为只读寄存器。",
  [0xBFFA500D] = "采集的记录所需的每通道采样点数超出了仪器采集存储器" ..
    "的容量。",
  [0xBFFA500E] = "该触发源或触发端子对此类触发或此仪器" ..
    "无效。",
  [0xBFFA500F] = "由通道列表和记录数得出的波形数与操作所需的数目不符，" ..
    "例如标量测量恰好需要一个波形。",
  [0xBFFA5010] = "无法对该波形进行测量。",
  [0xBFFA5011] = "选项字符串的 DriverSetup 条目指定了驱动程序无法识别的型号。",
  [0xBFFA5012] = "不支持该函数、采样格式或模式。",
  [0xBFFA5013] = "选项字符串无效：包含未知的选项名称或无效值。",
  [0xBFFA5014] = "驱动程序的内存或系统资源不足，或发生内部故障。",
  [0x3FFA5000] = "部分采样点达到垂直范围的边界，已被削波。",
}

return require("cvmxl_utilities").stringTable(entries)
