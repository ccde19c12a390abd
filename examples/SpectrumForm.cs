// A Windows form with a panel, late bound: no wrapper assembly has to be generated.
// Start: regsvr32 frontpanels.ocx of the program's own width, then in a project of `dotnet new winforms`
// (net8.0-windows, PlatformTarget x64 or x86) replace Program.cs by this file and `dotnet run`.
// Written by hand and not run by the project's tests, which have no .NET.
using System;
using System.Reflection;
using System.Runtime.InteropServices;
using System.Windows.Forms;

// The panel's requests to its host. A panel leaves the numbers of its events as they are.
[ComVisible(true), Guid("375c3225-6fe6-4d4a-b11c-2c0bd8d0be43"), InterfaceType(ComInterfaceType.InterfaceIsIDispatch)]
public interface ISpectrumViewEvents
{
    [DispId(1)] void frontPanelOp(int hwId, int vfpId, short OP, object argument, ref int status);
    [DispId(2)] void frontPanelSet(int hwId, int vfpId, short parameterType, short index, object newValue, ref int status);
    [DispId(3)] void saveDisplaySettings(int hwId, int vfpId, object list, ref int status);
    [DispId(4)] void saveSetup(int setUpId, int resourceId, int frontPanelId, ref int status);
}

public sealed class SpectrumPanel : AxHost
{
    public SpectrumPanel() : base(Type.GetTypeFromProgID("FrontPanels.SpectrumView", throwOnError: true).GUID.ToString()) { }

    public ISpectrumViewEvents Sink { get; set; }

    public object Call(string member, params object[] arguments) =>
        GetOcx().GetType().InvokeMember(member, BindingFlags.InvokeMethod, null, GetOcx(), arguments);

    // 13 centre and 14 span in Hz, 314 caption, ...
    public void Set(short code, object value) => Call("vfpSet", 0, code, (short)0, value);

    protected override void CreateSink()
    {
        if (Sink != null) connection = new ConnectionPointCookie(GetOcx(), Sink, typeof(ISpectrumViewEvents));
    }

    protected override void DetachSink()
    {
        connection?.Disconnect();
        connection = null;
    }

    private ConnectionPointCookie connection;
}

[ComVisible(true), ClassInterface(ClassInterfaceType.None)]
public sealed class SpectrumForm : Form, ISpectrumViewEvents
{
    private const string SpectrumPath = "Brantor Scanner/Spectrum/Spectrum Trace";
    private const short CodeCenter = 13, CodeSpan = 14, OpClose = 1;

    private readonly SpectrumPanel panel = new SpectrumPanel { Dock = DockStyle.Fill };
    private readonly System.Windows.Forms.Timer sweeps = new System.Windows.Forms.Timer { Interval = 100 };
    private readonly Random noise = new Random(1);
    private readonly object hub = Activator.CreateInstance(Type.GetTypeFromProgID("FrontPanels.DataHub", throwOnError: true));
    private double centerHz = 881.52e6, spanHz = 5e6;

    public SpectrumForm()
    {
        Text = "A receiver";
        ClientSize = new System.Drawing.Size(960, 680);
        panel.Sink = this;
        Controls.Add(panel);
        sweeps.Tick += (sender, e) => Publish();
    }

    protected override void OnLoad(EventArgs e)
    {
        base.OnLoad(e);
        panel.Set(CodeCenter, centerHz);
        panel.Set(CodeSpan, spanHz);
        panel.Call("vfpOp", 0, (short)12, 0);
        sweeps.Start();
    }

    private void Publish()
    {
        var levels = new float[513];
        for (int i = 0; i < levels.Length; ++i)
        {
            double offset = (centerHz + spanHz * (i / 512.0 - 0.5) - 881.52e6) / 60e3;
            levels[i] = (float)(-105 + 2 * noise.NextDouble() + 50 * Math.Exp(-offset * offset));
        }
        hub.GetType().InvokeMember("Publish", BindingFlags.InvokeMethod, null, hub, new object[] { SpectrumPath, levels });
    }

    // The user's wish. The status says whether it is taken; the value comes back through vfpSet.
    void ISpectrumViewEvents.frontPanelSet(int hwId, int vfpId, short parameterType, short index, object newValue, ref int status)
    {
        double hz = Convert.ToDouble(newValue);
        if (parameterType == CodeCenter) panel.Set(CodeCenter, centerHz = hz);
        if (parameterType == CodeSpan) panel.Set(CodeSpan, spanHz = hz);
    }

    void ISpectrumViewEvents.frontPanelOp(int hwId, int vfpId, short OP, object argument, ref int status)
    {
        if (OP == OpClose) BeginInvoke(new Action(Close));
    }

    void ISpectrumViewEvents.saveDisplaySettings(int hwId, int vfpId, object list, ref int status) { }
    void ISpectrumViewEvents.saveSetup(int setUpId, int resourceId, int frontPanelId, ref int status) { }

    [STAThread]
    private static void Main()
    {
        Application.EnableVisualStyles();
        Application.Run(new SpectrumForm());
    }
}
