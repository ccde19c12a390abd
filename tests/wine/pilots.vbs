' A drive test on the pilot panel: a dozen pilots that come and go, in 50 frames of all four sets. Its last line says
' that the script came to its end.
Const Pilots = 12
Const Frames = 50
Const ValuesOfAPilot = 6
Dim panel, cells, buffer, pathsOf(3)

Function Pn(pilot)
  Pn = 4 + 41 * pilot
End Function

' Each pilot is away for six of twenty frames, each at another time.
Function IsThere(pilot, frame)
  IsThere = (frame + 7 * pilot) Mod 20 < 14
End Function

' In the order of the paths behind Io: PN, peak, delay, aggregate, delay spread, aggregate minus peak. Quarters are
' exact as singles.
Function ValueOf(column, pilot, frame)
  Dim peak, aboveIt
  peak = -5 - pilot - ((3 * frame + 5 * pilot) Mod 7) / 4
  aboveIt = ((frame + pilot) Mod 4) / 4
  Select Case column
    Case 0 ValueOf = Pn(pilot)
    Case 1 ValueOf = peak
    Case 2 ValueOf = (37 * pilot + frame) Mod 200
    Case 3 ValueOf = peak + aboveIt
    Case 4 ValueOf = (pilot Mod 5) * 1.5 + 0.5
    Case 5 ValueOf = aboveIt
  End Select
End Function

Function Column(number, frame)
  Dim values, pilot
  Set values = CreateObject("Scripting.Dictionary")
  For pilot = 0 To Pilots - 1
    If IsThere(pilot, frame) Then values.Add pilot, ValueOf(number, pilot, frame)
  Next
  Column = values.Items
End Function

Function Levels(count, frame)
  Dim values, code, pilot
  Set values = CreateObject("Scripting.Dictionary")
  For code = 0 To count - 1
    values.Add "PN " & code, -28 + ((7919 * code + 31 * frame) Mod 97) / 32
  Next
  For pilot = 0 To Pilots - 1
    If IsThere(pilot, frame) And Pn(pilot) < count Then values("PN " & Pn(pilot)) = ValueOf(1, pilot, frame)
  Next
  Levels = values.Items
End Function

Sub PublishFrame(frame)
  Dim set_, number
  For set_ = 0 To 3
    hub.Publish pathsOf(set_)(0), -60 - (frame Mod 5)
  Next
  hub.Publish pathsOf(0)(1), Levels(512, frame)
  hub.Publish pathsOf(1)(1), Levels(64, frame)
  For number = 0 To ValuesOfAPilot - 1
    hub.Publish pathsOf(2)(number + 1), Column(number, frame)
    hub.Publish pathsOf(3)(number + 1), Column(number, frame)
  Next
End Sub

Function RecordsExpected(frame)
  Dim pilot, number
  For pilot = 0 To Pilots - 1
    For number = 0 To ValuesOfAPilot - 1
      If IsThere(pilot, frame) Then RecordsExpected = RecordsExpected & " " & ValueOf(number, pilot, frame)
    Next
  Next
End Function

Function Listed(values)
  Dim value
  For Each value In values
    Listed = Listed & " " & value
  Next
End Function

' Scripts cannot look into arrays of anything but variants; the hub can.
Function Items(array_)
  Dim item
  hub.Publish "read back", array_
  For item = 0 To hub.ItemCount("read back") - 1
    Items = Items & " " & hub.Value("read back", item)
  Next
End Function

Function Count(array_)
  hub.Publish "read back", array_
  Count = hub.ItemCount("read back")
End Function

Sub NewPanel()
  Dim own, i
  own = Array(panel.DfiAllPilots, panel.DfiZoomedPilots, panel.DfiPilotTopNMultipath, panel.DfiPilotListMultipath)
  For i = 0 To 3
    pathsOf(i) = Split(own(i), Chr(27))
  Next
  Check "a trace has two paths", UBound(pathsOf(0)) & UBound(pathsOf(1)), "11"
  Check "bars have seven", UBound(pathsOf(2)) & UBound(pathsOf(3)), "66"
  Check "the first is that of Io", pathsOf(2)(0), "Brantor Scanner/Cdma Pilot Top N Multipath/Io"
  Check "without data a set is an array without elements", Count(panel.AllPilotsData) & Count(panel.TopNData), "00"
  Check "of singles", VarType(panel.UserListData), vbArray + vbSingle
  Check "nothing has been updated", panel.UpdateCount, 0
End Sub

Sub Names()
  Dim pilot
  Check "at first there are no names", panel.CellNameInfo Is Nothing, True
  Set cells = CreateObject("FrontPanels.clsCellNameInfo")
  For pilot = 0 To Pilots - 1
    cells.SetCellName Pn(pilot), -1, "Cell " & Chr(65 + pilot)
  Next
  Check "names are switched on", panel.vfpSet(0, 799, 0, True), 0
  Set panel.CellNameInfo = cells
  Check "names are taken and given back", panel.CellNameInfo Is cells, True
  On Error Resume Next
  Set panel.CellNameInfo = hub
  Check "a strange object is error 13", Err.Number & Err.Description, "13Type mismatch"
  Err.Clear
  Check "and changes nothing", panel.CellNameInfo Is cells, True
  panel.CellNameInfo = Nothing
  Check "Nothing takes them back", Err.Number & (panel.CellNameInfo Is Nothing), "0True"
  Set panel.CellNameInfo = cells
  Check "and they come again", panel.CellNameInfo Is cells, True
End Sub

Sub Drive()
  Dim frame, seen, types
  For frame = 0 To Frames - 1
    PublishFrame frame
    If frame = 0 Then
      panel.hSplitter = 0.5
      panel.vSplitter = 0.25
    End If
    If frame Mod 10 = 0 Then seen = seen & " " & Count(panel.TopNData) / ValuesOfAPilot
    If Items(panel.TopNData) <> RecordsExpected(frame) Then Check "records of frame " & frame, Items(panel.TopNData), RecordsExpected(frame)
  Next
  Check "pilots come and go", seen, " 8 9 8 9 8"
  Check "four sets were updated in each frame", panel.UpdateCount, 4 * Frames
  Check "the last records are read back", Items(panel.TopNData), RecordsExpected(Frames - 1)
  Check "those of the list too", Items(panel.UserListData), RecordsExpected(Frames - 1)
  Check "as are the levels", Items(panel.AllPilotsData), Listed(Levels(512, Frames - 1))
  Check "and those of the window", Items(panel.ZoomedPilotsData), Listed(Levels(64, Frames - 1))
  Check "splitters are kept", panel.hSplitter & " " & panel.vSplitter, "0.5 0.25"
  panel.measurementInfo types
  Check "the panel names its four sets", Items(types), " 14 18 201 200"
  Check "all of them are switched on", SetsShown(), "1111"
  Check "Io is that of the last frame", panel.Constituent("I0TextBox").Text, "-64 dBm"
  Check "nothing was reported", diagnostics.Count, 0
  panel.SavePicture folder & "\pilots.png"
End Sub

Function SetsShown()
  Dim name
  For Each name In Array("allPilotsCheckBox", "zoomedPilotsCheckBox", "topNPilotsCheckBox", "userListCheckBox")
    SetsShown = SetsShown & panel.Constituent(name).Value
  Next
End Function

Sub BadFrames()
  Dim before
  before = panel.UpdateCount
  hub.Publish pathsOf(2)(1), Array(1, 2, 3)
  hub.Publish pathsOf(2)(6), Array(1, 2)
  Check "a frame of two lengths is reported", LastMessage(), "Tarvex::DfiPilotTopNMultipath_DataChanged()|Subscript out of range"
  hub.Publish pathsOf(0)(1), Levels(514, 0)
  Check "and a trace that is too long", LastMessage(), "Tarvex::DfiAllPilots_DataChanged()|Subscript out of range"
  hub.Publish pathsOf(0)(0), "loud"
  Check "and an Io that is no number", LastMessage(), "Tarvex::DfiAllPilots_DataChanged()|Type mismatch"
  Check "the last good ones stay", Items(panel.TopNData) & Count(panel.AllPilotsData), RecordsExpected(Frames - 1) & "512"
  Check "and count no update", panel.UpdateCount, before
  diagnostics.Clear
End Sub

Sub PnList()
  Dim box, entry, value
  Set box = panel.Constituent("userPNListListBox")
  Set entry = panel.Constituent("userPNListTextBox")
  For Each value In Array(12, 300, 511)
    entry.Text = value
    entry.KeyPress 13
    panel.Constituent("userPNListAddButton").Click
  Next
  Check "three offsets are in the list", box.ListCount & " " & box.ItemData(0) & " " & box.ItemData(1) & " " & box.ItemData(2), "3 12 300 511"
  Check "nothing is chosen, nothing to delete", panel.Constituent("userPNListDeleteButton").Enabled, False
  box.ListIndex = 1
  panel.Constituent("userPNListDeleteButton").Click
  Check "the chosen one goes", box.ListCount & " " & box.ItemData(1), "2 511"
  Check "the host inserts one", panel.vfpSet(0, 230, 1, 77) & " " & box.ItemData(1), "0 77"
  Check "and deletes it", panel.vfpSet(0, 230, -2, 77) & " " & box.ItemData(1), "0 511"
  panel.vfpSet 0, 230, -2, 77
  Check "another than it says stays", LastMessage() & box.ListCount, "Tarvex::vfpSet()...CDMA_CODE_OFFSET to delete is inconsistent with the index|2"
  diagnostics.Clear
End Sub

Sub Displays()
  Dim before
  before = panel.UpdateCount
  Check "a set is switched off", panel.vfpSet(0, 750, 0, False) & SetsShown(), "01101"
  PublishFrame 0
  Check "its data do not bring it back", SetsShown() & " " & panel.UpdateCount - before, "1101 3"
  Check "though they are there", Items(panel.TopNData), RecordsExpected(0)
  Check "the host does", panel.vfpOp(0, 10, 201) & SetsShown(), "01111"
  Check "and removes another", panel.vfpOp(0, 11, 18) & SetsShown(), "01011"
  Check "a set that is none is unusable", panel.vfpOp(0, 10, 10), -8
  Check "markers go on a trace", panel.vfpSet(0, 737, 0, 11), 0
  panel.addMarker
  panel.markerToMax
  panel.addDeltaMarker
  panel.markerToMin
  panel.deleteMarker
  Check "without a report", diagnostics.Count, 0
End Sub

Sub Results()
  Dim records, bytes, cursor, bytesLeft, io
  io = -72.5
  records = Array(8, -6, 20, -5.5, 2, 0.5, 16, -9, 30, -8.5, 4, 0.5)
  panel.vfpSet 0, 312, 0, 1
  Set buffer = CreateObject("FrontPanels.ResultBuffer")
  buffer.HardwareId 0
  buffer.BeginMeasurement 1
  buffer.BeginSubMeasurement 1
  buffer.BeginRecord 201
  buffer.Float32 io
  buffer.Float32Array records
  buffer.EndRecord
  buffer.EndSubMeasurement
  buffer.EndMeasurement
  cursor = 0
  bytesLeft = buffer.Length
  bytes = buffer.Bytes
  Check "a result buffer brings a set whole", panel.displayData(Empty, bytes, cursor, bytesLeft, 0, 0) & Items(panel.TopNData), "0" & Listed(records)
End Sub

Sub Carrier()
  panel.DfiCarrier = "mine/error" & Chr(27) & "mine/state" & Chr(27) & "mine/pps"
  hub.Publish "mine/error", -12.5
  hub.Publish "mine/state", "locked"
  hub.Publish "mine/pps", 17.9
  Check "readings come by other paths", panel.Constituent("CarrierErrorLabel").Caption & "; " & panel.Constituent("CarrierStateLabel").Caption & "; " & panel.Constituent("onePpsLabel").Caption, "Carrier Freq Error = -12.5; Carrier Freq State = locked; 1PPS = 17"
  Check "whose names are read back", Replace(panel.DfiCarrier, Chr(27), "|"), "mine/error|mine/state|mine/pps"
  panel.DfiCarrier = ""
  hub.Publish "mine/pps", 18
  Check "without paths nothing comes", panel.Constituent("onePpsLabel").Caption, "1PPS = 17"
End Sub

Sub Restored()
  Dim again, list, i
  panel.vfpSet 0, 500, 0, 2
  panel.vfpSet 0, 803, 0, 1920
  panel.vfpSet 0, 730, 0, 1
  panel.vfpSet 0, 732, 0, -18
  list = panel.Settings
  Set again = CreateObject("FrontPanels.Tarvex")
  For Each i In Array(14, 18, 200, 201)
    again.vfpOp 0, 10, i
  Next
  For i = 0 To UBound(list) Step 2
    If again.vfpSet(0, list(i), 0, list(i + 1)) <> 0 Then Check "setting " & list(i) & " is taken", False, True
  Next
  Check "what was handed over restores another panel", Listed(again.Settings), Listed(list)
  Check "a code is counted in its format", again.Constituent("CodeStartTextBox").Text, panel.Constituent("CodeStartTextBox").Text
  again.vfpOp 0, 1
  PublishFrame 1
  Check "closed it takes nothing more", again.UpdateCount, 0
  Check "and nothing was reported", diagnostics.Count, 0
End Sub

Set panel = CreateObject("FrontPanels.Tarvex")
NewPanel
Names
Drive
BadFrames
PnList
Displays
Results
Carrier
Restored
Set panel = Nothing
WScript.Echo "script finished"
