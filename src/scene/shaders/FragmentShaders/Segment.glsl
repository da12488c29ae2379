// A bone, lit from above, from the eye, and a little from the floor. A dark stripe shows how it is turned.
const float c_StripeDarkness = 0.33;

uniform mat4 u_View;
uniform vec3 u_Up;

varying vec4 v_Colour;
varying vec3 v_Normal;
varying vec3 v_LocalNormal;

void main()
{
	float light = Light(normalize(v_Normal), ToCamera(u_View), u_Up, c_Lights);
	if (v_LocalNormal.y > 0.0 && abs(v_LocalNormal.x) < 0.1)
		light *= 1.0 - c_StripeDarkness;
	gl_FragColor = vec4(v_Colour.rgb * light, v_Colour.a);
}
