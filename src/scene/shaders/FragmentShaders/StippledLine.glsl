// A line of dashes of four pixels.
varying vec4 v_Colour;
varying vec2 v_Screen;

void main()
{
	if (fract(0.125 * (v_Screen.x + v_Screen.y)) > 0.5)
		discard;
	gl_FragColor = v_Colour;
}
