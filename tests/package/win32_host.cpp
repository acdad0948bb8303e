// A host program: one window, a plate with a square hole, one captured picture. Exits with 0
// when the hole shows the background and the plate around it is drawn.
#include <windows.h>

#include <karvel/karvel.h>

int main()
{
    WNDCLASSA windowClass = {};
    windowClass.style = CS_OWNDC;  // the modeller keeps drawing into the DC it was initialised on
    windowClass.lpfnWndProc = DefWindowProcA;
    windowClass.hInstance = GetModuleHandleA(nullptr);
    windowClass.lpszClassName = "KarvelHost";
    RegisterClassA(&windowClass);
    HWND window = CreateWindowA("KarvelHost", "karvel host", WS_OVERLAPPEDWINDOW | WS_VISIBLE, 0, 0, 320, 240,
                                nullptr, nullptr, windowClass.hInstance, nullptr);
    HDC dc = GetDC(window);

    CVelGLKarvel modeller;
    if (!modeller.Initialize(dc))
        return 1;
    CDorHolePolygon plate({{0, 0, 0}, {4, 0, 0}, {4, 4, 0}, {0, 4, 0}});
    plate.AddHole(CDorPolygon({{1, 1, 0}, {3, 1, 0}, {3, 3, 0}, {1, 3, 0}}));  // the outline's way round
    CDorHoleExtruded block(plate, DorVector3(0, 0, 1));
    CDorShape shape;
    shape.Add(&block);
    modeller.AddShape(shape);

    _VelCamera camera;
    modeller.GetCamera(camera);
    camera.eye = DorVector3(2, 2, 10);  // looking straight down on the plate's centre
    camera.target = DorVector3(2, 2, 0);
    modeller.SetCamera(camera);

    _DorBitmap picture;  // 24-bit rows, bottom row first, blue-green-red
    _DORRECT size = {0, 0, 64, 64};
    modeller.ToBitmap(picture, size);
    if (picture.info.width != 64 || picture.info.height != 64)
        return 2;
    const unsigned char* centre = &picture.bits[32 * 64 * 3 + 32 * 3];
    const unsigned char* onPlate = &picture.bits[(32 + 12) * 64 * 3 + 32 * 3];
    bool holeIsBackground = centre[0] == 0 && centre[1] == 0 && centre[2] == 0;
    bool plateIsDrawn = onPlate[0] + onPlate[1] + onPlate[2] > 0;
    return holeIsBackground && plateIsDrawn ? 0 : 3;
}
